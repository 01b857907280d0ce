#pragma once

namespace VelaMediaLib {

/// The kind of one stream of a media file. A screen recording's picture
/// stream is ScreenVideo (or ScreenImage for a single frame), so that its
/// source can make the screen-recording clip kinds for it.
enum class TrackType { Unknown = 0, Video = 1, Audio = 2, Image = 3, ScreenVideo = 4, ScreenImage = 5 };

/// Streams with a picture: video, images and their screen-recorded kinds.
inline bool isVisualTrackType(TrackType type) {
    return type == TrackType::Video || type == TrackType::Image || type == TrackType::ScreenVideo ||
           type == TrackType::ScreenImage;
}

inline bool isAudioTrackType(TrackType type) { return type == TrackType::Audio; }

} // namespace VelaMediaLib
