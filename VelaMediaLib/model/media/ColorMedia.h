#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

namespace VelaMediaLib {

/// A generated clip of one solid colour (attribute "color"). It has no media
/// extent: its static editor changes only the track range, and it can be
/// extended without limit.
class VELAMEDIALIB_API ColorMedia : public VisualMediaImpl {
public:
    static boost::shared_ptr<ColorMedia>
    create(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
           VelaTime start, VelaTime duration,
           const TemplatedColor<int>& color = TemplatedColor<int>(0, 0, 0, 255));

    TemplatedColor<int> color() const { return attributeValue("color", TemplatedColor<int>()); }

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;

private:
    ColorMedia(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
               const MediaState& initial)
        : Media(token), VisualMedia(token), VisualMediaImpl(token, rate, initial, Static) {}
};

} // namespace VelaMediaLib
