#pragma once

#include <string>

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

/// The type's name in the project document: "unknown", "video", "audio",
/// "image", "screenVideo", "screenImage".
inline const char* trackTypeName(TrackType type) {
    switch (type) {
    case TrackType::Video:
        return "video";
    case TrackType::Audio:
        return "audio";
    case TrackType::Image:
        return "image";
    case TrackType::ScreenVideo:
        return "screenVideo";
    case TrackType::ScreenImage:
        return "screenImage";
    default:
        return "unknown";
    }
}

/// The type of a document name; false for a name no type has.
inline bool trackTypeFromName(const std::string& name, TrackType& type) {
    for (const TrackType candidate : {TrackType::Unknown, TrackType::Video, TrackType::Audio,
                                      TrackType::Image, TrackType::ScreenVideo, TrackType::ScreenImage})
        if (name == trackTypeName(candidate)) {
            type = candidate;
            return true;
        }
    return false;
}

} // namespace VelaMediaLib
