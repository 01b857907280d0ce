#include <VelaMediaLib/model/media/StitchedMediaChildrensTimeConverter.h>

#include <VelaMediaLib/model/media/StitchedMedia.h>

#include <stdexcept>

namespace VelaMediaLib {

// Each conversion reads the stitched media's state once, so that an edit on
// another thread cannot mix two states into one answer.
SafeRational StitchedMediaChildrensTimeConverter::parentParametricTimeToThisParametricTime(
    const SafeRational& time) const {
    const boost::shared_ptr<const StitchedMedia> stitched = stitched_.lock();
    if (!stitched) return time;
    const MediaState state = stitched->state();
    return state.mediaStart + time / state.scalar;
}

SafeRational StitchedMediaChildrensTimeConverter::clippingParentParametricTimeToThisParametricTime(
    const SafeRational& time) const {
    const boost::shared_ptr<const StitchedMedia> stitched = stitched_.lock();
    if (!stitched) return time;
    const MediaState state = stitched->state();
    SafeRational inside = time;
    if (inside < 0) inside = SafeRational(0);
    if (inside > state.duration) inside = SafeRational(state.duration);
    return state.mediaStart + inside / state.scalar;
}

SafeRational StitchedMediaChildrensTimeConverter::thisParametricTimeToParentParametricTime(
    const SafeRational& time) const {
    const boost::shared_ptr<const StitchedMedia> stitched = stitched_.lock();
    if (!stitched) return time;
    const MediaState state = stitched->state();
    return (time - state.mediaStart) * state.scalar;
}

TimeConverterPtr StitchedMediaChildrensTimeConverter::parentTimeConverter() const { return stitched_.lock(); }

void StitchedMediaChildrensTimeConverter::setTimeConverterParent(const boost::weak_ptr<SubTimeline>&) {
    throw std::runtime_error("ChildrensTimeConverter::setTimeConverterParent not supported");
}

} // namespace VelaMediaLib
