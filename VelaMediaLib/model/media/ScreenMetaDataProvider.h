#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/KeystrokeData.h>
#include <VelaMediaLib/base/Point3d.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

#include <utility>
#include <vector>

namespace VelaMediaLib {

/// A mouse click of a screen recording.
struct VELAMEDIALIB_API ScreenClick {
    enum Button { Left, Right, Middle };

    RationalTime time;
    Button button = Left;

    ScreenClick() = default;
    ScreenClick(const RationalTime& time_, Button button_) : time(time_), button(button_) {}

    bool operator==(const ScreenClick& o) const { return time == o.time && button == o.button; }
    bool operator!=(const ScreenClick& o) const { return !(*this == o); }
};

/// A key pressed during a screen recording.
struct VELAMEDIALIB_API ScreenKeystroke {
    RationalTime time;
    KeystrokeData keystroke;

    ScreenKeystroke() = default;
    ScreenKeystroke(const RationalTime& time_, KeystrokeData keystroke_)
        : time(time_), keystroke(std::move(keystroke_)) {}

    bool operator==(const ScreenKeystroke& o) const { return time == o.time && keystroke == o.keystroke; }
    bool operator!=(const ScreenKeystroke& o) const { return !(*this == o); }
};

/// What a screen recording tells of the cursor, the clicks and the keys
/// beyond its picture: the questions a clip made of several recordings
/// forwards to each of its parts.
///
/// Times are the recording's media time: ticks of the project edit rate
/// counted on the source (the unit of a clip's media start), exact as
/// RationalTime so that samples between ticks keep their place. Positions
/// are pixels of the recording, z always 0. A range is a start and a
/// duration and holds its start but not its end, so that ranges laid end to
/// end count every event once.
class VELAMEDIALIB_API ScreenMetaDataProvider {
public:
    virtual ~ScreenMetaDataProvider() = default;

    /// Whether any cursor position was recorded.
    virtual bool hasCursorData() const = 0;
    /// Between samples the cursor moves in a straight line; before the first
    /// and after the last it stays where they have it. The origin without samples.
    virtual Point3d cursorPositionAtTime(const RationalTime& time) const = 0;
    /// In time order; both throw ValueException<const SafeRational> for a negative duration.
    virtual std::vector<ScreenClick> clicksInRange(const Range<RationalTime>& range) const = 0;
    virtual std::vector<ScreenKeystroke> keystrokesInRange(const Range<RationalTime>& range) const = 0;
    /// The part of the screen recorded, in screen pixels.
    virtual Rect<int> recordingRect() const = 0;
};

} // namespace VelaMediaLib
