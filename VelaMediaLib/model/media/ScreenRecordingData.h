#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/ScreenMetaDataProvider.h>

#include <boost/shared_ptr.hpp>
#include <vector>

namespace VelaMediaLib {

class XMLOptions;

/// A cursor position at a time of the recording.
struct VELAMEDIALIB_API ScreenCursorSample {
    RationalTime time;
    Point3d position;

    ScreenCursorSample() = default;
    ScreenCursorSample(const RationalTime& time_, const Point3d& position_)
        : time(time_), position(position_) {}

    bool operator==(const ScreenCursorSample& o) const { return time == o.time && position == o.position; }
    bool operator!=(const ScreenCursorSample& o) const { return !(*this == o); }
};

/// The metadata of one screen recording: cursor samples, clicks and
/// keystrokes, each kept in time order whatever order they were added in,
/// and the rectangle recorded. It is built by its add operations and then
/// shared as a const value (clips hold it by shared pointer to const), so
/// its queries take no lock; each is a binary search.
///
/// Times are the recording's media time, as ScreenMetaDataProvider says. A
/// cursor sample at a time already sampled replaces that sample; clicks and
/// keystrokes at one time keep the order they were added in.
class VELAMEDIALIB_API ScreenRecordingData : public ScreenMetaDataProvider {
public:
    explicit ScreenRecordingData(const Rect<int>& recordingRect = Rect<int>()) : rect_(recordingRect) {}

    /// A recording of nothing, shared: what a clip without data answers from.
    static boost::shared_ptr<const ScreenRecordingData> empty();

    void addCursorSample(const RationalTime& time, const Point3d& position);
    void addClick(const RationalTime& time, ScreenClick::Button button);
    void addKeystroke(const RationalTime& time, const KeystrokeData& keystroke);
    void setRecordingRect(const Rect<int>& rect) { rect_ = rect; }

    const std::vector<ScreenCursorSample>& cursorSamples() const { return cursor_; }
    const std::vector<ScreenClick>& clicks() const { return clicks_; }
    const std::vector<ScreenKeystroke>& keystrokes() const { return keys_; }

    bool hasCursorData() const override { return !cursor_.empty(); }
    Point3d cursorPositionAtTime(const RationalTime& time) const override;
    std::vector<ScreenClick> clicksInRange(const Range<RationalTime>& range) const override;
    std::vector<ScreenKeystroke> keystrokesInRange(const Range<RationalTime>& range) const override;
    Rect<int> recordingRect() const override { return rect_; }
    bool isEmpty() const { return cursor_.empty() && clicks_.empty() && keys_.empty(); }
    /// The recording's object, closed at indent: "recordingRect" [x, y, w, h],
    /// "cursor" [[time, x, y], ...], "clicks" [[time, button], ...] (0 left,
    /// 1 right, 2 middle), "keystrokes" [[time, {"key", "modifiers"}], ...];
    /// times are rationals (ScreenRecordingDataDocument.cpp).
    void toJSON(XMLOptions& options, int indent) const;

    bool operator==(const ScreenRecordingData& o) const {
        return rect_ == o.rect_ && cursor_ == o.cursor_ && clicks_ == o.clicks_ && keys_ == o.keys_;
    }
    bool operator!=(const ScreenRecordingData& o) const { return !(*this == o); }

private:
    Rect<int> rect_;
    std::vector<ScreenCursorSample> cursor_;
    std::vector<ScreenClick> clicks_;
    std::vector<ScreenKeystroke> keys_;
};

} // namespace VelaMediaLib
