#include <VelaMediaLib/document/MixerReader.h>
#include <VelaMediaLib/document/TrackReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

#include <algorithm>
#include <map>

namespace VelaMediaLib {

MixerReader::MixerReader(const boost::shared_ptr<ReadContext>& context,
                         const boost::shared_ptr<GenericMixer>& mixer)
    : JSONReader(context), mixer_(mixer) {}

bool MixerReader::read(const Json::Value& tracks) {
    setValue(tracks);
    documentArray(tracks, "an array of tracks");
    std::map<long long, TrackPtr> byIndex;
    for (Json::ArrayIndex i = 0; i < tracks.size(); ++i) {
        const Json::Value& entry = tracks[i];
        documentObject(entry, "a track object");
        const Json::Value* index = optionalMember(entry, "trackIndex");
        const long long place = index ? jsonValueAsInt64(*index) : static_cast<long long>(i);
        if (byIndex.count(place)) refuseDocument("duplicate trackIndex: " + std::to_string(place));
        TrackReader reader(readContext());
        reader.read(entry);
        byIndex[place] = reader.track();
        // The caller owns the tree and lets it be consumed: the track is built.
        if (context().releaseTracks) Json::Value().swap(const_cast<Json::Value&>(entry));
    }
    for (const auto& entry : byIndex) mixer_->addTrack(entry.second);
    return true;
}

} // namespace VelaMediaLib
