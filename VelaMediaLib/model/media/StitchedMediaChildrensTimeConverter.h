#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeConverter.h>

#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

class StitchedMedia;
class SubTimeline;

/// What a stitched media's internal track names as its converter parent: it
/// maps the stitched media's parametric time (ticks from its start on its own
/// track) to the time of its internal track, where its parts lie end to end,
/// and back. Internal time = media start + parametric time / scalar, exactly,
/// so a part's time follows every trim and stretch of the stitched media.
/// Its own parent is the stitched media, held weakly: once that has gone the
/// converter passes times through unchanged and names no parent.
class VELAMEDIALIB_API StitchedMediaChildrensTimeConverter : public TimeConverter {
public:
    explicit StitchedMediaChildrensTimeConverter(const boost::weak_ptr<const StitchedMedia>& stitched)
        : stitched_(stitched) {}

    /// Stitched parametric time to internal track time.
    SafeRational parentParametricTimeToThisParametricTime(const SafeRational& time) const override;
    /// The same after clipping the time to the stitched media's duration.
    SafeRational clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const override;
    /// Internal track time to stitched parametric time.
    SafeRational thisParametricTimeToParentParametricTime(const SafeRational& time) const override;
    TimeConverterPtr parentTimeConverter() const override;

    /// The converter belongs to its stitched media for good: throws
    /// std::runtime_error "ChildrensTimeConverter::setTimeConverterParent not supported".
    void setTimeConverterParent(const boost::weak_ptr<SubTimeline>& parent);

private:
    boost::weak_ptr<const StitchedMedia> stitched_;
};

} // namespace VelaMediaLib
