#include <VelaMediaLib/model/media/ChildrensTimeConverter.h>

#include <VelaMediaLib/model/media/Media.h>

#include <stdexcept>

namespace VelaMediaLib {

SafeRational
ChildrensTimeConverter::parentParametricTimeToThisParametricTime(const SafeRational& time) const {
    const boost::shared_ptr<const Media> outer = container();
    if (!outer) return time;
    const MediaState state = outer->state();
    return state.mediaStart + time / state.scalar;
}

SafeRational
ChildrensTimeConverter::clippingParentParametricTimeToThisParametricTime(const SafeRational& time) const {
    const boost::shared_ptr<const Media> outer = container();
    if (!outer) return time;
    const MediaState state = outer->state();
    const SafeRational inside = time < SafeRational(0)                ? SafeRational(0)
                                : time > SafeRational(state.duration) ? SafeRational(state.duration)
                                                                      : time;
    return state.mediaStart + inside / state.scalar;
}

SafeRational
ChildrensTimeConverter::thisParametricTimeToParentParametricTime(const SafeRational& time) const {
    const boost::shared_ptr<const Media> outer = container();
    if (!outer) return time;
    const MediaState state = outer->state();
    return (time - state.mediaStart) * state.scalar;
}

TimeConverterPtr ChildrensTimeConverter::parentTimeConverter() const { return container(); }

void ChildrensTimeConverter::setTimeConverterParent(const boost::weak_ptr<SubTimeline>&) {
    throw std::runtime_error("ChildrensTimeConverter::setTimeConverterParent not supported");
}

} // namespace VelaMediaLib
