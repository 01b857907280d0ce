#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeConverter.h>

#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

class Group;
class SubTimeline;

/// What a group's mixer reports as its parent converter: the step between
/// the group's parametric time (ticks from its start on its track) and the
/// time of the group's own tracks, on which its children stand. The group
/// plays its inner time from its media start at its scalar, so inner time =
/// media start + parametric time / scalar, exactly. The next converter
/// outward is the group itself. The converter lives inside its group and is
/// handed out sharing the group's ownership; it cannot be re-parented.
class VELAMEDIALIB_API GroupChildrensTimeConverter : public TimeConverter {
public:
    explicit GroupChildrensTimeConverter(const Group& group) : group_(group) {}

    /// Group parametric time to the time of the group's tracks.
    SafeRational parentParametricTimeToThisParametricTime(const SafeRational& time) const override;
    /// The same, the parametric time first held to the group's duration.
    SafeRational clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const override;
    /// The time of the group's tracks to the group's parametric time.
    SafeRational thisParametricTimeToParentParametricTime(const SafeRational& time) const override;
    TimeConverterPtr parentTimeConverter() const override;
    /// Throws std::runtime_error: the converter always leads to its group.
    void setTimeConverterParent(const boost::weak_ptr<SubTimeline>& parent);

private:
    const Group& group_;
};

} // namespace VelaMediaLib
