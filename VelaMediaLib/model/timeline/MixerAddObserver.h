#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class Media;
class Mixer;
class Track;

/// Told of every track a mixer gains or loses, and of every clip its tracks
/// gain or lose, from within the edit that did it.
class VELAMEDIALIB_API MixerAddObserver {
public:
    virtual ~MixerAddObserver() = default;
    virtual void onMixerAddTrack(Mixer& mixer, const boost::shared_ptr<Track>& track) = 0;
    virtual void onMixerRemoveTrack(Mixer& mixer, const boost::shared_ptr<Track>& track) = 0;
    virtual void onMixerAddMedia(Mixer& mixer, Track& track, const boost::shared_ptr<Media>& media) = 0;
    virtual void onMixerRemoveMedia(Mixer& mixer, Track& track, const boost::shared_ptr<Media>& media) = 0;
};

} // namespace VelaMediaLib
