#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/timeline/Mixer.h>

namespace VelaMediaLib {

/// The concrete mixer.
class VELAMEDIALIB_API GenericMixer : public Mixer {
public:
    static boost::shared_ptr<GenericMixer> create(const boost::weak_ptr<const ThreadSafe>& token);

    /// Index -1 appends; 0 to the number of tracks inserts there; any other
    /// throws ValueException<int> "invalid index".
    void addTrack(const TrackPtr& track, int index = -1) { addTrackSansTypeCheck(track, index); }
    /// Puts a removed track back where it was.
    void putBack(const RemoveTrackInfo& info) { addTrackSansTypeCheck(info.track, info.index); }
    MixerPtr cloneEmpty() const override;

private:
    explicit GenericMixer(const boost::weak_ptr<const ThreadSafe>& token)
        : SubTimeline(token), Mixer(token) {}
};

} // namespace VelaMediaLib
