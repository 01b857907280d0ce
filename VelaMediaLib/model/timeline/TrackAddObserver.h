#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class Media;
class Track;

/// Told of every clip a track gains or loses, from within the edit that did it.
class VELAMEDIALIB_API TrackAddObserver {
public:
    virtual ~TrackAddObserver() = default;
    virtual void onTrackAddMedia(Track& track, const boost::shared_ptr<Media>& media) = 0;
    virtual void onTrackRemoveMedia(Track& track, const boost::shared_ptr<Media>& media) = 0;
};

} // namespace VelaMediaLib
