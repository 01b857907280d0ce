#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class Media;
class Mixer;
class Timeline;
class Track;

/// Told of every mixer, track and clip a timeline gains or loses.
class VELAMEDIALIB_API TimelineAddObserver {
public:
    virtual ~TimelineAddObserver() = default;
    virtual void onTimelineAddTrack(Timeline&, Mixer&, const boost::shared_ptr<Track>&) {}
    virtual void onTimelineRemoveTrack(Timeline&, Mixer&, const boost::shared_ptr<Track>&) {}
    virtual void onTimelineAddMixer(Timeline&, const boost::shared_ptr<Mixer>&) {}
    virtual void onTimelineRemoveMixer(Timeline&, const boost::shared_ptr<Mixer>&) {}
    virtual void onTimelineAddMedia(Timeline&, Track&, const boost::shared_ptr<Media>&) {}
    virtual void onTimelineRemoveMedia(Timeline&, Track&, const boost::shared_ptr<Media>&) {}
};

} // namespace VelaMediaLib
