#include <VelaMediaLib/model/timeline/GenericTrack.h>

namespace VelaMediaLib {

boost::shared_ptr<GenericTrack> GenericTrack::create(const boost::weak_ptr<const ThreadSafe>& token) {
    return boost::shared_ptr<GenericTrack>(new GenericTrack(token));
}

void GenericTrack::addMedia(const MediaPtr& media, VelaTime start) { addMediaSansTypeCheck(media, start); }

boost::shared_ptr<Track> GenericTrack::cloneEmpty() const {
    const boost::shared_ptr<GenericTrack> copy = create(projectMutex());
    copyFlagsInto(*copy);
    return copy;
}

} // namespace VelaMediaLib
