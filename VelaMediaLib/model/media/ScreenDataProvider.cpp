#include <VelaMediaLib/model/media/ScreenDataProvider.h>

#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

namespace VelaMediaLib {

boost::shared_ptr<const ScreenRecordingData> ScreenDataHolder::screenData() const {
    ScopedReadLock lock(projectLock());
    return data_;
}

void ScreenDataHolder::setScreenData(const boost::shared_ptr<const ScreenRecordingData>& data) {
    ScopedWriteLock lock(projectMutex());
    data_ = data;
}

boost::shared_ptr<const ScreenRecordingData> ScreenDataHolder::answering() const {
    const boost::shared_ptr<const ScreenRecordingData> held = screenData();
    return held ? held : ScreenRecordingData::empty();
}

bool ScreenDataHolder::hasCursorData() const { return answering()->hasCursorData(); }
Point3d ScreenDataHolder::cursorPositionAtTime(const RationalTime& time) const {
    return answering()->cursorPositionAtTime(time);
}
std::vector<ScreenClick> ScreenDataHolder::clicksInRange(const Range<RationalTime>& range) const {
    return answering()->clicksInRange(range);
}
std::vector<ScreenKeystroke> ScreenDataHolder::keystrokesInRange(const Range<RationalTime>& range) const {
    return answering()->keystrokesInRange(range);
}
Rect<int> ScreenDataHolder::recordingRect() const { return answering()->recordingRect(); }

} // namespace VelaMediaLib
