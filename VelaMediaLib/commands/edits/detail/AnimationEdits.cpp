#include <VelaMediaLib/commands/edits/detail/AnimationEdits.h>

#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>

#include <algorithm>
#include <set>
#include <sstream>

namespace VelaMediaLib {
namespace {

/// The document text of a parameter's curve, to tell whether an edit changed it.
std::string curveText(const ParameterInterface& parameter) {
    std::ostringstream out;
    XMLOptions options(out);
    parameter.toJSON(options, 0, "curve");
    return out.str();
}

} // namespace

AnimationTracksEditCmd::AnimationTracksEditCmd(const MediaPtr& media) : media_(media) {
    if (!dynamic_cast<MediaImpl*>(media.get()))
        throw VelaMediaLibException("no clip with animation tracks to edit");
}

AnimationTracksEditCmd::AnimationLists AnimationTracksEditCmd::animationsOf(const MediaPtr& media) {
    AnimationLists lists;
    if (const auto* clip = dynamic_cast<const MediaImpl*>(media.get()))
        for (const auto& entry : clip->animationTracks()) lists[entry.first] = entry.second.animations();
    return lists;
}

void AnimationTracksEditCmd::checkInterpolaterCode(const std::string& code) {
    if (!code.empty() && !InterpolaterFactory<double>::find(code))
        throw VelaMediaLibException("unknown interpolater code \"" + code + "\"");
}

void AnimationTracksEditCmd::checkParameter(const MediaPtr& media, const std::string& name) {
    const std::vector<std::string> names = media->parameterNames(); // asks without making any
    if (!std::binary_search(names.begin(), names.end(), name))
        throw VelaMediaLibException("the clip has no parameter \"" + name + "\"");
}

void AnimationTracksEditCmd::checkLength(VelaTime length) {
    if (length < 1) throw ValueException<long long>("an animation lasts at least one tick", length);
}

void AnimationTracksEditCmd::reshape(Animation& animation, VelaTime start, VelaTime length) {
    animation.range = Range<long long>(start, length);
    animation.endTime = start + length;
    animation.duration = std::min<VelaTime>(std::max<VelaTime>(animation.duration, 0), length);
}

AnimationTracksEditCmd::Animation* AnimationTracksEditCmd::find(AnimationLists& lists,
                                                                const std::string& name, VelaTime start) {
    const auto list = lists.find(name);
    if (list == lists.end()) return nullptr;
    for (Animation& animation : list->second)
        if (animation.range.start() == start) return &animation;
    return nullptr;
}

// A changed track is kept in start order; its animations last a tick or more
// and none begins before the one ahead of it has ended.
bool AnimationTracksEditCmd::holds(Animations& animations) {
    std::stable_sort(animations.begin(), animations.end(), [](const Animation& a, const Animation& b) {
        return a.range.start() < b.range.start();
    });
    for (size_t i = 0; i < animations.size(); ++i) {
        if (animations[i].range.duration() < 1) return false;
        if (i > 0 && animations[i - 1].range.end() > animations[i].range.start()) return false;
    }
    return true;
}

bool AnimationTracksEditCmd::execute(CommandHandler*) {
    AnimationLists before = animationsOf(media_), after = before;
    if (!edit(after)) return false;
    bool changed = false;
    for (auto& entry : after) {
        const auto was = before.find(entry.first);
        const bool same = was != before.end() ? was->second == entry.second : entry.second.empty();
        if (same) continue;
        if (!holds(entry.second)) return false;
        changed = true;
    }
    for (const auto& entry : before) changed = changed || !after.count(entry.first);
    if (!changed) return false;
    before_ = before;
    after_ = after;
    apply(after_);
    return true;
}

bool AnimationTracksEditCmd::unexecute(CommandHandler*) {
    apply(before_);
    return true;
}

bool AnimationTracksEditCmd::reexecute(CommandHandler*) {
    apply(after_);
    return true;
}

// Every track named on either side takes the wanted animations (none removes it).
void AnimationTracksEditCmd::apply(const AnimationLists& lists) const {
    auto& clip = dynamic_cast<MediaImpl&>(*media_);
    std::set<std::string> names;
    for (const auto& entry : clip.animationTracks()) names.insert(entry.first);
    for (const auto& entry : lists) names.insert(entry.first);
    for (const std::string& name : names) {
        const auto wanted = lists.find(name);
        clip.setAnimationTrack(name,
                               AnimationTrack(name, wanted == lists.end() ? Animations() : wanted->second));
    }
}

void ParameterCurvesEditCmd::track(const ParameterPtr& parameter) {
    if (!parameter) throw VelaMediaLibException("no parameter to edit");
    for (const Curve& curve : curves_)
        if (curve.parameter == parameter) return;
    curves_.push_back(
        Curve{MediaPtr(), std::string(), parameter, parameter->cloneParameter(), ParameterPtr()});
}

ParameterCurvesEditCmd::ParameterPtr ParameterCurvesEditCmd::track(const MediaPtr& media,
                                                                   const std::string& name) {
    const bool made = media->hasMadeParameter(name);
    const ParameterPtr parameter = media->parameter(name);
    if (!parameter) throw VelaMediaLibException("the clip has no parameter \"" + name + "\"");
    track(parameter);
    if (!made) {
        curves_.back().owner = media;
        curves_.back().name = name;
    }
    return parameter;
}

bool ParameterCurvesEditCmd::execute(CommandHandler*) {
    curves_.clear();
    bool done = false;
    try {
        done = edit();
    } catch (const KeyFrameException&) {
        done = false;
    } catch (...) {
        rollBack();
        throw;
    }
    bool changed = false;
    for (Curve& curve : curves_) {
        curve.after = curve.parameter->cloneParameter();
        changed = changed || curve.owner || curveText(*curve.before) != curveText(*curve.after);
    }
    if (done && changed) return true;
    rollBack();
    return false;
}

void ParameterCurvesEditCmd::rollBack() {
    for (auto curve = curves_.rbegin(); curve != curves_.rend(); ++curve) {
        if (curveText(*curve->parameter) != curveText(*curve->before)) give(curve->parameter, curve->before);
        if (curve->owner) curve->owner->removeParameter(curve->name);
    }
    curves_.clear();
}

bool ParameterCurvesEditCmd::unexecute(CommandHandler*) {
    for (auto curve = curves_.rbegin(); curve != curves_.rend(); ++curve) {
        give(curve->parameter, curve->before);
        if (curve->owner) curve->owner->removeParameter(curve->name);
    }
    return true;
}

bool ParameterCurvesEditCmd::reexecute(CommandHandler*) {
    for (const Curve& curve : curves_) {
        if (curve.owner) curve.owner->addParameter(curve.name, curve.parameter);
        give(curve.parameter, curve.after);
    }
    return true;
}

// The parameter takes a fresh copy of the saved curve, staying the same object.
void ParameterCurvesEditCmd::give(const ParameterPtr& parameter, const ParameterPtr& saved) {
    const ParameterPtr copy = saved->cloneParameter();
    if (!parameter->takeStateOf(*copy)) throw VelaMediaLibFatalException("a parameter changed its kind");
    parameter->notify();
}

} // namespace VelaMediaLib
