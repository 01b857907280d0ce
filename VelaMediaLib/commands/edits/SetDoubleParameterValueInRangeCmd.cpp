#include <VelaMediaLib/commands/edits/SetDoubleParameterValueInRangeCmd.h>

#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>

#include <algorithm>
#include <cmath>

namespace VelaMediaLib {
namespace {

void addStep(Parameter<double>& parameter, const RationalTime& time, double value) {
    const boost::shared_ptr<KeyFrame<double>> step(new KeyFrame<double>(
        parameter.projectMutex(), time, value, RationalTime(0), LeftInterpolater<double>::getInstance()));
    parameter.addKeyFrame(step);
}

} // namespace

void SetDoubleParameterValueInRangeCmd::checkRange(const Range<RationalTime>& range, double value) {
    if (range.duration() <= RationalTime(0))
        throw ValueException<double>("a range to set a value in lasts longer than 0",
                                     range.duration().asDouble());
    if (!std::isfinite(value)) throw ValueException<double>("a parameter's value must be a number", value);
}

boost::shared_ptr<SetDoubleParameterValueInRangeCmd>
SetDoubleParameterValueInRangeCmd::create(const boost::shared_ptr<Parameter<double>>& parameter,
                                          const Range<RationalTime>& range, double value) {
    if (!parameter) throw VelaMediaLibException("no parameter to set a value of");
    checkRange(range, value);
    boost::shared_ptr<SetDoubleParameterValueInRangeCmd> command(
        new SetDoubleParameterValueInRangeCmd(parameter, range, value));
    command->setName("Set Value In Range");
    return command;
}

// The inner keyframes go first, so that none of their lead-ins refuses an
// edge; the only keyframe cannot go until the edges stand, so the inner ones
// are asked for again last.
void SetDoubleParameterValueInRangeCmd::setInRange(Parameter<double>& parameter,
                                                   const Range<RationalTime>& range, double value) {
    const RationalTime start = range.start(), end = range.start() + range.duration();
    const double after = parameter.valueAtTime(end);
    const auto removeInner = [&] {
        const auto times = parameter.keyframeTimes();
        for (const RationalTime& time : *times)
            if (start < time && time < end) parameter.removeKeyFrame(time);
    };
    removeInner();
    addStep(parameter, start, value);
    addStep(parameter, end, after);
    removeInner();
}

bool SetDoubleParameterValueInRangeCmd::edit() {
    track(parameter_);
    setInRange(*parameter_, range_, value_);
    return true;
}

boost::shared_ptr<SetVolumeInRangeCmd>
SetVolumeInRangeCmd::create(const MediaPtr& media, const Range<VelaTime>& range, double volume) {
    if (!media) throw VelaMediaLibException("no clip to set the volume of");
    const std::vector<std::string> names = media->parameterNames();
    if (!std::binary_search(names.begin(), names.end(), std::string("volume")))
        throw VelaMediaLibException("the clip has no volume");
    SetDoubleParameterValueInRangeCmd::checkRange(
        Range<RationalTime>(RationalTime(range.start()), RationalTime(range.duration())), volume);
    if (volume < 0) throw ValueException<double>("a volume is not below 0", volume);
    boost::shared_ptr<SetVolumeInRangeCmd> command(new SetVolumeInRangeCmd(media, range, volume));
    command->setName("Set Volume In Range");
    return command;
}

bool SetVolumeInRangeCmd::edit() {
    const auto volume = boost::dynamic_pointer_cast<Parameter<double>>(track(media_, "volume"));
    if (!volume) throw TypeException("the clip's volume is not a number parameter");
    SetDoubleParameterValueInRangeCmd::setInRange(
        *volume, Range<RationalTime>(RationalTime(range_.start()), RationalTime(range_.duration())), volume_);
    return true;
}

} // namespace VelaMediaLib
