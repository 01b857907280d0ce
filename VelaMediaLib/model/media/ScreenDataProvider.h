#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/ScreenMetaDataProvider.h>
#include <VelaMediaLib/model/media/ScreenRecordingData.h>
#include <VelaMediaLib/time/sync/ProjectToken.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

/// A screen-recorded clip: it answers the metadata questions from a data
/// object it holds, which it hands out and can be given.
class VELAMEDIALIB_API ScreenDataProvider : public ScreenMetaDataProvider {
public:
    /// Null when the clip has no screen data.
    virtual boost::shared_ptr<const ScreenRecordingData> screenData() const = 0;
    virtual void setScreenData(const boost::shared_ptr<const ScreenRecordingData>& data) = 0;
};

/// ScreenDataProvider for a clip kind to inherit: it forwards every question
/// to the data it holds, and without data answers as a recording of nothing
/// (no cursor, the origin, no clicks or keys, an empty rectangle). The data
/// never changes once held, so a query copies the pointer under the
/// project's read lock and asks it after letting go.
class ScreenDataHolder;
class XMLOptions;
/// Writes the holder's "screenData" member when it holds any.
VELAMEDIALIB_API void writeScreenData(XMLOptions& options, int indent, const ScreenDataHolder& holder);

class VELAMEDIALIB_API ScreenDataHolder : public ScreenDataProvider, public virtual ProjectToken {
public:
    explicit ScreenDataHolder(
        const boost::weak_ptr<const ThreadSafe>& token = boost::weak_ptr<const ThreadSafe>()) {
        recordProjectToken(token);
    }

    boost::shared_ptr<const ScreenRecordingData> screenData() const override;
    /// Takes the project's write lock; tells no one (a kind that notifies overrides it).
    void setScreenData(const boost::shared_ptr<const ScreenRecordingData>& data) override;

    bool hasCursorData() const override;
    Point3d cursorPositionAtTime(const RationalTime& time) const override;
    std::vector<ScreenClick> clicksInRange(const Range<RationalTime>& range) const override;
    std::vector<ScreenKeystroke> keystrokesInRange(const Range<RationalTime>& range) const override;
    Rect<int> recordingRect() const override;

private:
    /// The data held, or a recording of nothing; the copy keeps it for the
    /// length of a question even when it is replaced meanwhile.
    boost::shared_ptr<const ScreenRecordingData> answering() const;

    boost::shared_ptr<const ScreenRecordingData> data_;
};

} // namespace VelaMediaLib
