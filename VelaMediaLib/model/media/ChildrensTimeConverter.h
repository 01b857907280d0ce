#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeConverter.h>

#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

class Media;
class SubTimeline;

/// What a clip made of clips hands its children as their time converter:
/// the container's parametric time to the time of its inner tracks, where
/// the children stand, and back. The container plays its inner time from
/// its media start at its scalar, so inner time = media start + parametric
/// time / scalar, exactly; each conversion reads the container's state once.
/// The next converter outward is the container; once it has gone, times
/// pass through unchanged. The converter cannot be re-parented.
class VELAMEDIALIB_API ChildrensTimeConverter : public TimeConverter {
public:
    SafeRational parentParametricTimeToThisParametricTime(const SafeRational& time) const override;
    /// The same, the parametric time first held to the container's duration.
    SafeRational clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const override;
    SafeRational thisParametricTimeToParentParametricTime(const SafeRational& time) const override;
    TimeConverterPtr parentTimeConverter() const override;
    /// Throws std::runtime_error "ChildrensTimeConverter::setTimeConverterParent not supported".
    void setTimeConverterParent(const boost::weak_ptr<SubTimeline>& parent);

protected:
    /// The clip whose children this converter serves, or null once it has gone.
    virtual boost::shared_ptr<const Media> container() const = 0;
};

} // namespace VelaMediaLib
