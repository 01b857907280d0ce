#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/timeline/CollisionException.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

/// The concrete track that timelines and groups make.
class VELAMEDIALIB_API GenericTrack : public Track {
public:
    static boost::shared_ptr<GenericTrack> create(const boost::weak_ptr<const ThreadSafe>& token);

    /// Places the clip at the start tick; throws CollisionException where it
    /// would overlap another clip, and changes nothing then.
    void addMedia(const MediaPtr& media, VelaTime start);
    boost::shared_ptr<Track> cloneEmpty() const override;

private:
    explicit GenericTrack(const boost::weak_ptr<const ThreadSafe>& token)
        : SubTimeline(token), Track(token) {}
};

} // namespace VelaMediaLib
