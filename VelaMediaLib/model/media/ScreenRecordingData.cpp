#include <VelaMediaLib/model/media/ScreenRecordingData.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <algorithm>
#include <boost/make_shared.hpp>

namespace VelaMediaLib {
namespace {

template <typename Event>
bool before(const RationalTime& time, const Event& event) {
    return time < event.time;
}
template <typename Event>
bool earlier(const Event& event, const RationalTime& time) {
    return event.time < time;
}

/// After any events at the same time: those keep the order they came in.
template <typename Event>
void insertInOrder(std::vector<Event>& events, Event event) {
    const auto at = std::upper_bound(events.begin(), events.end(), event.time, before<Event>);
    events.insert(at, std::move(event));
}

/// The events from the range's start up to, not including, its end.
template <typename Event>
std::vector<Event> eventsIn(const std::vector<Event>& events, const Range<RationalTime>& range) {
    if (range.duration() < RationalTime(0))
        throw ValueException<const SafeRational>("screen data range has a negative duration",
                                                 range.duration().asRational());
    const auto first = std::lower_bound(events.begin(), events.end(), range.start(), earlier<Event>);
    const auto last = std::lower_bound(first, events.end(), range.end(), earlier<Event>);
    return std::vector<Event>(first, last);
}

double lerp(double from, double to, double fraction) { return from + (to - from) * fraction; }

} // namespace

boost::shared_ptr<const ScreenRecordingData> ScreenRecordingData::empty() {
    static const boost::shared_ptr<const ScreenRecordingData> nothing =
        boost::make_shared<const ScreenRecordingData>();
    return nothing;
}

void ScreenRecordingData::addCursorSample(const RationalTime& time, const Point3d& position) {
    const auto at = std::lower_bound(cursor_.begin(), cursor_.end(), time, earlier<ScreenCursorSample>);
    if (at != cursor_.end() && at->time == time)
        at->position = position;
    else
        cursor_.insert(at, ScreenCursorSample(time, position));
}

void ScreenRecordingData::addClick(const RationalTime& time, ScreenClick::Button button) {
    insertInOrder(clicks_, ScreenClick(time, button));
}

void ScreenRecordingData::addKeystroke(const RationalTime& time, const KeystrokeData& keystroke) {
    insertInOrder(keys_, ScreenKeystroke(time, keystroke));
}

Point3d ScreenRecordingData::cursorPositionAtTime(const RationalTime& time) const {
    if (cursor_.empty()) return Point3d();
    const auto next = std::upper_bound(cursor_.begin(), cursor_.end(), time, before<ScreenCursorSample>);
    if (next == cursor_.begin()) return next->position;
    const ScreenCursorSample& from = *std::prev(next);
    if (next == cursor_.end() || from.time == time) return from.position;
    const double fraction =
        ((time.asRational() - from.time.asRational()) / (next->time.asRational() - from.time.asRational()))
            .asDouble();
    return Point3d(lerp(from.position.x, next->position.x, fraction),
                   lerp(from.position.y, next->position.y, fraction),
                   lerp(from.position.z, next->position.z, fraction));
}

std::vector<ScreenClick> ScreenRecordingData::clicksInRange(const Range<RationalTime>& range) const {
    return eventsIn(clicks_, range);
}

std::vector<ScreenKeystroke> ScreenRecordingData::keystrokesInRange(const Range<RationalTime>& range) const {
    return eventsIn(keys_, range);
}

} // namespace VelaMediaLib
