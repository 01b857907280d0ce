#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

namespace VelaMediaLib {

/// A visual clip without content, standing in for media to come. Its temporal
/// editor works over its own media range: it can be trimmed within the slice
/// it was made with, not beyond. Attributes "width", "height" (pixels) and "note".
class VELAMEDIALIB_API PlaceholderMedia : public VisualMediaImpl {
public:
    /// A placeholder on the track from start for duration ticks, at scalar 1.
    static boost::shared_ptr<PlaceholderMedia> create(const boost::weak_ptr<const ThreadSafe>& token,
                                                      const boost::weak_ptr<ProjectEditRate>& rate,
                                                      VelaTime start, VelaTime duration, int width = 1920,
                                                      int height = 1080,
                                                      const std::string& note = std::string());
    /// A placeholder playing the media slice at the scalar, from start (as documents hold it).
    static boost::shared_ptr<PlaceholderMedia>
    createFromMediaRange(const boost::weak_ptr<const ThreadSafe>& token,
                         const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                         const SafeRational& mediaStart, const SafeRational& mediaDuration,
                         const SafeRational& scalar = SafeRational(1));

    int width() const { return attributeValue<int>("width", 0); }
    int height() const { return attributeValue<int>("height", 0); }
    std::string note() const { return attributeValue<std::string>("note", std::string()); }

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;

private:
    PlaceholderMedia(const boost::weak_ptr<const ThreadSafe>& token,
                     const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial)
        : Media(token), VisualMedia(token), VisualMediaImpl(token, rate, initial, Temporal) {}
};

} // namespace VelaMediaLib
