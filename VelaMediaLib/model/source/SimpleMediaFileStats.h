#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/SafeRational.h>

namespace VelaMediaLib {

class MediaFileStats;

/// The few figures of a media file a host shows in a list.
struct VELAMEDIALIB_API SimpleMediaFileStats {
    int width = 0;
    int height = 0;
    /// Seconds, over all streams.
    double duration = 0;
    int numTracks = 0;
    SafeRational videoFrameRate;
    SafeRational audioSampleRate;

    /// The size is the file's picture rectangle, or the first visual stream's
    /// when the file gives none.
    static SimpleMediaFileStats from(const MediaFileStats& stats);
};

} // namespace VelaMediaLib
