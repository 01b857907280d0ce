#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

class Mixer;
class Track;

/// What a track's removal needs to be undone: the track, the mixer it left
/// and the index it had there.
struct VELAMEDIALIB_API RemoveTrackInfo {
    boost::shared_ptr<Track> track;
    boost::weak_ptr<Mixer> mixer;
    int index = -1;
};

} // namespace VelaMediaLib
