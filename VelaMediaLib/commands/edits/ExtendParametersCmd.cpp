#include <VelaMediaLib/commands/edits/ExtendParametersCmd.h>

#include <VelaMediaLib/time/parameters/ParameterInterface.h>

namespace VelaMediaLib {

KeyframeTimeCmd::KeyframeTimeCmd(const MediaPtr& media, VelaTime time, VelaTime amount, bool extend)
    : ClipTimeCmd(media, time, amount, extend, "move keyframes of", "keyframe") {}

std::vector<boost::shared_ptr<ParameterInterface>> KeyframeTimeCmd::parametersToMove() const {
    std::vector<boost::shared_ptr<ParameterInterface>> found;
    const RationalTime from(extend_ ? time_ : time_ + amount_);
    for (const std::string& name : media_->parameterNames()) {
        if (!media_->hasMadeParameter(name)) continue;
        const boost::shared_ptr<ParameterInterface> parameter = media_->parameter(name);
        if (!parameter || parameter->numKeyFrames() < 2) continue;
        bool moves = false;
        const boost::shared_ptr<std::vector<RationalTime>> times = parameter->keyframeTimes();
        for (const RationalTime& time : *times) {
            if (!extend_ && time >= RationalTime(time_) && time < from)
                throw KeyFrameException("a keyframe lies in the time being removed", time,
                                        parameter->identifier());
            moves = moves || time >= from;
        }
        if (moves) found.push_back(parameter);
    }
    return found;
}

void KeyframeTimeCmd::moveAll(const std::vector<boost::shared_ptr<ParameterInterface>>& parameters,
                              bool forwards) const {
    // Forwards an extension moves what lies from the time on; backwards it
    // finds them again where they went (and the reverse for a reduction).
    const bool later = extend_ == forwards;
    const RationalTime offset(later ? amount_ : -amount_);
    const RationalTime from(later ? time_ : time_ + amount_);
    const auto select = [from](const RationalTime& time) { return time >= from; };
    size_t done = 0;
    try {
        for (; done < parameters.size(); ++done) parameters[done]->moveKeyframes(offset, select);
    } catch (...) {
        const RationalTime back = -offset;
        const RationalTime movedFrom = from + offset;
        while (done-- > 0)
            parameters[done]->moveKeyframes(back,
                                            [movedFrom](const RationalTime& t) { return t >= movedFrom; });
        throw;
    }
}

bool KeyframeTimeCmd::execute(CommandHandler*) {
    moved_.clear();
    if (amount_ == 0) return false;
    std::vector<boost::shared_ptr<ParameterInterface>> parameters = parametersToMove();
    moveAll(parameters, true);
    moved_.swap(parameters);
    return !moved_.empty();
}

bool KeyframeTimeCmd::unexecute(CommandHandler*) {
    moveAll(moved_, false);
    return true;
}

bool KeyframeTimeCmd::reexecute(CommandHandler*) {
    moveAll(moved_, true);
    return true;
}

boost::shared_ptr<ExtendParametersCmd> ExtendParametersCmd::create(const MediaPtr& media, VelaTime time,
                                                                   VelaTime amount) {
    const boost::shared_ptr<ExtendParametersCmd> command(new ExtendParametersCmd(media, time, amount));
    command->setName("Extend Parameters");
    return command;
}

boost::shared_ptr<ReduceParametersCmd> ReduceParametersCmd::create(const MediaPtr& media, VelaTime time,
                                                                   VelaTime amount) {
    const boost::shared_ptr<ReduceParametersCmd> command(new ReduceParametersCmd(media, time, amount));
    command->setName("Reduce Parameters");
    return command;
}

} // namespace VelaMediaLib
