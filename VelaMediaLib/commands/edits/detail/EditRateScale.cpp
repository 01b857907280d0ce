#include <VelaMediaLib/commands/edits/detail/EditRateScale.h>

#include <VelaMediaLib/model/media/RationalStaticEditor.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>

namespace VelaMediaLib {
namespace {

SafeRational rationalOf(const boost::rational<unsigned long>& rate) {
    if (rate.numerator() == 0) throw ValueException<double>("an edit rate must be greater than 0", 0.0);
    return SafeRational((long long)rate.numerator(), (long long)rate.denominator());
}

bool hasMediaExtent(const Media& media) {
    return !dynamic_cast<const RationalStaticEditor*>(&media.rationalMediaEditor());
}

} // namespace

EditRateScale::EditRateScale(const SafeRational& factor) : factor_(factor) {
    if (factor <= SafeRational(0))
        throw ValueException<double>("an edit rate factor must be above zero", factor.asDouble());
}

EditRateScale EditRateScale::between(const boost::rational<unsigned long>& from,
                                     const boost::rational<unsigned long>& to) {
    return EditRateScale(rationalOf(to) / rationalOf(from));
}

VelaTime EditRateScale::tick(VelaTime time) const {
    return RationalUtil::Round(SafeRational(time) * factor_).asVelaTime();
}

MediaState EditRateScale::clipState(const Media& media, const MediaState& state, VelaTime start) const {
    MediaState next = state;
    next.start = start;
    next.mediaStart = exact(state.mediaStart);
    if (!state.minUnbounded()) next.minMediaStart = exact(state.minMediaStart);
    if (!state.maxUnbounded()) next.maxMediaEnd = exact(state.maxMediaEnd);
    if (hasMediaExtent(media)) {
        next.mediaDuration = exact(state.mediaDuration);
        next.duration = RationalUtil::Round(next.mediaDuration * state.scalar).asVelaTime();
    } else {
        // The media follows the duration by the same ratio, so that a static
        // clip's media duration stays its duration over its scalar.
        next.duration = tick(state.duration);
        if (next.duration > 0)
            next.mediaDuration =
                state.mediaDuration * SafeRational(next.duration) / SafeRational(state.duration);
    }
    if (next.duration <= 0)
        throw ValueException<double>("a clip would last no tick at the new edit rate", factor_.asDouble());
    return next;
}

std::vector<MediaState> EditRateScale::trackStates(const std::vector<MediaPtr>& clips) const {
    std::vector<MediaState> states;
    VelaTime oldEnd = 0, newEnd = 0;
    for (const MediaPtr& clip : clips) {
        const MediaState state = clip->state();
        VelaTime start = tick(state.start);
        if (!states.empty()) start = state.start == oldEnd ? newEnd : std::max(start, newEnd);
        states.push_back(clipState(*clip, state, start));
        oldEnd = state.start + state.duration;
        newEnd = states.back().start + states.back().duration;
    }
    return states;
}

// Growing, keyframes move latest first and lead-ins grow afterwards; shrinking,
// lead-ins shrink first and keyframes move earliest first. Either way each
// step keeps every keyframe clear of its neighbours' lead-ins. Keyframes
// before 0 mirror those after it.
void EditRateScale::scaleKeyframes(ParameterInterface& parameter) const {
    if (isIdentity() || parameter.numKeyFrames() == 0) return;
    const std::vector<RationalTime> times = *parameter.keyframeTimes();
    std::vector<RationalTime> order;
    const bool grow = factor_ > SafeRational(1);
    for (auto t = times.rbegin(); t != times.rend(); ++t)
        if ((t->asRational() > SafeRational(0)) == grow) order.push_back(*t);
    for (const RationalTime& t : times)
        if ((t.asRational() > SafeRational(0)) != grow) order.push_back(t);
    const auto scaleLeadIns = [&](bool moved) {
        for (const RationalTime& t : times) {
            const RationalTime at = moved ? RationalTime(exact(t.asRational())) : t;
            const boost::shared_ptr<KeyFrameInterface> keyframe = parameter.keyFrameInterfaceAtTime(at);
            const SafeRational leadIn = keyframe ? keyframe->duration().asRational() : SafeRational(0);
            if (leadIn != SafeRational(0))
                parameter.changeKeyFrameLeadInLength(at, RationalTime(exact(leadIn)));
        }
    };
    if (!grow) scaleLeadIns(false);
    for (const RationalTime& t : order)
        if (t.asRational() != SafeRational(0)) parameter.moveKeyFrame(t, RationalTime(exact(t.asRational())));
    if (grow) scaleLeadIns(true);
}

} // namespace VelaMediaLib
