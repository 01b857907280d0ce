#include <VelaMediaLib/model/media/GroupChildrensTimeConverter.h>

#include <VelaMediaLib/model/media/Group.h>

#include <stdexcept>

namespace VelaMediaLib {

SafeRational
GroupChildrensTimeConverter::parentParametricTimeToThisParametricTime(const SafeRational& time) const {
    const MediaState state = group_.state();
    return state.mediaStart + time / state.scalar;
}

SafeRational GroupChildrensTimeConverter::clippingParentParametricTimeToThisParametricTime(
    const SafeRational& time) const {
    const MediaState state = group_.state();
    const SafeRational inside = time < 0                ? SafeRational(0)
                                : time > state.duration ? SafeRational(state.duration)
                                                        : time;
    return state.mediaStart + inside / state.scalar;
}

SafeRational
GroupChildrensTimeConverter::thisParametricTimeToParentParametricTime(const SafeRational& time) const {
    const MediaState state = group_.state();
    return (time - state.mediaStart) * state.scalar;
}

TimeConverterPtr GroupChildrensTimeConverter::parentTimeConverter() const {
    return group_.shared_from_this();
}

void GroupChildrensTimeConverter::setTimeConverterParent(const boost::weak_ptr<SubTimeline>&) {
    throw std::runtime_error("ChildrensTimeConverter::setTimeConverterParent not supported");
}

} // namespace VelaMediaLib
