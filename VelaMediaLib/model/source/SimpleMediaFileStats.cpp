#include <VelaMediaLib/model/source/SimpleMediaFileStats.h>

#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

namespace VelaMediaLib {
namespace {

Rect<int> pictureOf(const MediaFileStats::Contents& contents) {
    if (contents.rect.width != 0 || contents.rect.height != 0) return contents.rect;
    for (const TrackStats& track : contents.tracks)
        if (isVisualTrackType(track.type)) return track.rect;
    return Rect<int>();
}

} // namespace

SimpleMediaFileStats SimpleMediaFileStats::from(const MediaFileStats& stats) {
    ScopedReadLock lock(stats.projectLock()); // one state for every figure
    const MediaFileStats::Contents contents = stats.contents();
    SimpleMediaFileStats result;
    const Rect<int> picture = pictureOf(contents);
    result.width = picture.width;
    result.height = picture.height;
    result.duration = stats.mediaRangeInSeconds().duration();
    result.numTracks = int(contents.tracks.size());
    result.videoFrameRate = stats.videoFrameRateOfFirstVideoTrack();
    result.audioSampleRate = stats.audioSampleRateOfFirstAudioTrack();
    return result;
}

} // namespace VelaMediaLib
