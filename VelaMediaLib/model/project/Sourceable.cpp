#include <VelaMediaLib/model/project/Sourceable.h>

#include <VelaMediaLib/model/media/Media.h>

#include <algorithm>

namespace VelaMediaLib {

std::vector<boost::shared_ptr<const Source>> Sourceable::sourcesOf(const std::vector<MediaPtr>& clips) {
    std::vector<boost::shared_ptr<const Source>> sources;
    for (const MediaPtr& clip : clips)
        if (const auto sourceable = boost::dynamic_pointer_cast<Sourceable>(clip))
            if (const auto source = sourceable->source())
                if (std::find(sources.begin(), sources.end(), source) == sources.end())
                    sources.push_back(source);
    return sources;
}

std::vector<MediaPtr> Sourceable::clipsOf(const std::vector<MediaPtr>& clips,
                                          const boost::shared_ptr<const Source>& source) {
    std::vector<MediaPtr> found;
    for (const MediaPtr& clip : clips) {
        const auto sourceable = boost::dynamic_pointer_cast<Sourceable>(clip);
        if (sourceable && source && sourceable->source() == source) found.push_back(clip);
    }
    return found;
}

} // namespace VelaMediaLib
