#include <VelaMediaLib/commands/edits/ScaleMediaEditRateCmd.h>

#include <VelaMediaLib/commands/edits/ScaleMixerEditRateCmd.h>
#include <VelaMediaLib/commands/edits/SetMediaStateCmd.h>
#include <VelaMediaLib/effects/StoredEffect.h>
#include <VelaMediaLib/model/media/Caption.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

namespace VelaMediaLib {
namespace {

/// What a clip holds in ticks besides its timing and what it contains. Each
/// part is saved before it changes, so undo, and a failure part-way, put
/// back exactly what was there.
class ScaleClipContentStep : public Command {
public:
    ScaleClipContentStep(const MediaPtr& media, const EditRateScale& scale) : media_(media), scale_(scale) {}

    bool execute(CommandHandler*) override {
        saved_ = Saved();
        try {
            scaleEdges();
            scaleEffects();
            scaleAnimations();
            scaleCaption();
            scaleParameters();
        } catch (...) {
            restore();
            throw;
        }
        return true;
    }
    bool unexecute(CommandHandler*) override {
        restore();
        return true;
    }

private:
    struct Saved {
        std::vector<std::pair<EdgeModificationPtr, VelaTime>> edges;
        boost::optional<Effectable::Effects> effects; // the list before, when scaled
        MediaImpl::AnimationTracks animations;
        boost::optional<long long> captionMax;
        std::vector<std::pair<boost::shared_ptr<ParameterInterface>, boost::shared_ptr<ParameterInterface>>>
            parameters;
    };

    void scaleEdges() {
        EdgeModifiable::EdgeModifications edges = media_->leftEdgeModifications();
        const EdgeModifiable::EdgeModifications right = media_->rightEdgeModifications();
        edges.insert(edges.end(), right.begin(), right.end());
        ScopedWriteLock lock(media_->projectMutex());
        for (const EdgeModificationPtr& edge : edges) {
            saved_.edges.emplace_back(edge, edge->duration());
            edge->setDuration(scale_.tick(edge->duration()));
        }
    }
    // Effects are values: the list goes back whole, since a later edit undone
    // or redone may have put equal copies in place of the scaled ones.
    void scaleEffects() {
        const Effectable::Effects before = media_->allEffects();
        Effectable::Effects after = before;
        bool scaled = false;
        for (Effectable::EffectPtr& effect : after) {
            const auto stored = boost::dynamic_pointer_cast<StoredEffect>(effect);
            if (!stored || (stored->fields().start == 0 && stored->fields().duration == 0)) continue;
            StoredEffect::Fields fields = stored->fields();
            fields.start = scale_.tick(fields.start);
            fields.duration = scale_.tick(fields.duration);
            effect = StoredEffect::create(fields);
            scaled = true;
        }
        if (!scaled) return;
        media_->replaceAllEffects(after);
        saved_.effects = before;
    }
    void scaleAnimations() {
        MediaImpl* const impl = dynamic_cast<MediaImpl*>(media_.get());
        if (!impl) return;
        saved_.animations = impl->animationTracks();
        for (const auto& entry : saved_.animations) {
            std::vector<AnimationTrack::Animation> animations = entry.second.animations();
            for (AnimationTrack::Animation& a : animations) {
                a.range = Range<long long>(scale_.tick(a.range.start()), scale_.tick(a.range.duration()));
                a.endTime = scale_.tick(a.endTime);
                a.duration = scale_.tick(a.duration);
            }
            impl->setAnimationTrack(entry.first, AnimationTrack(entry.second.name(), animations));
        }
    }
    void scaleCaption() {
        Caption* const caption = dynamic_cast<Caption*>(media_.get());
        if (!caption || caption->maxMediaDuration() == Caption::kNoMaxMediaDuration) return;
        saved_.captionMax = caption->maxMediaDuration();
        caption->setMaxMediaDuration(scale_.tick(*saved_.captionMax));
    }
    // A stitched clip's parameters list its parts' keyframes: the parts carry them.
    void scaleParameters() {
        if (dynamic_cast<StitchedMedia*>(media_.get())) return;
        for (const std::string& name : media_->parameterNames()) {
            if (!media_->hasMadeParameter(name)) continue;
            const boost::shared_ptr<ParameterInterface> parameter = media_->parameter(name);
            if (!parameter || parameter->numKeyFrames() == 0) continue;
            saved_.parameters.emplace_back(parameter, parameter->cloneParameter());
            scale_.scaleKeyframes(*parameter);
        }
    }

    // Everything goes back in reverse order of its change.
    void restore() {
        for (auto p = saved_.parameters.rbegin(); p != saved_.parameters.rend(); ++p) {
            p->first->takeStateOf(*p->second);
            p->first->notify();
        }
        if (saved_.captionMax) dynamic_cast<Caption&>(*media_).setMaxMediaDuration(*saved_.captionMax);
        if (MediaImpl* const impl = dynamic_cast<MediaImpl*>(media_.get()))
            for (const auto& entry : saved_.animations) impl->setAnimationTrack(entry.first, entry.second);
        if (saved_.effects) media_->replaceAllEffects(*saved_.effects);
        {
            ScopedWriteLock lock(media_->projectMutex());
            for (const auto& edge : saved_.edges) edge.first->setDuration(edge.second);
        }
        saved_ = Saved();
    }

    MediaPtr media_;
    EditRateScale scale_;
    Saved saved_;
};

} // namespace

boost::shared_ptr<ScaleMediaEditRateCmd>
ScaleMediaEditRateCmd::create(const TrackPtr& track, const MediaPtr& media, const SafeRational& factor) {
    const boost::shared_ptr<ScaleMediaEditRateCmd> command(
        new ScaleMediaEditRateCmd(track, media, EditRateScale(factor), boost::none));
    command->setName("Scale Media Edit Rate");
    return command;
}

boost::shared_ptr<ScaleMediaEditRateCmd> ScaleMediaEditRateCmd::create(const TrackPtr& track,
                                                                       const MediaPtr& media,
                                                                       const SafeRational& factor,
                                                                       VelaTime start) {
    const boost::shared_ptr<ScaleMediaEditRateCmd> command(
        new ScaleMediaEditRateCmd(track, media, EditRateScale(factor), start));
    command->setName("Scale Media Edit Rate");
    return command;
}

// The clip's own timing first, then what it holds: a group's inner time is
// its media time, which the first step has already carried over.
void ScaleMediaEditRateCmd::executeCommands(const CommandHandler*) {
    if (!media_ || scale_.isIdentity()) return;
    const MediaState state = media_->state();
    const VelaTime start = start_ ? *start_ : scale_.tick(state.start);
    const MediaState scaled = scale_.clipState(*media_, state, start);
    if (!executeRequired(partOfTrack_ ? SetMediaStateCmd::createRounded(track_, media_, scaled)
                                      : SetMediaStateCmd::create(track_, media_, scaled)))
        return;
    execute(CommandPtr(new ScaleClipContentStep(media_, scale_)));
    if (const auto visual = boost::dynamic_pointer_cast<VisualMediaImpl>(media_))
        if (visual->hotspot() && !executeRequired(ScaleHotspotEditRateCmd::create(media_, scale_.factor())))
            return;
    if (const auto group = boost::dynamic_pointer_cast<Group>(media_)) {
        const auto inner = ScaleMixerEditRateCmd::create(group->mixer(), scale_.factor());
        if (partOfTrack_) inner->withoutFits(); // the track's change fits its groups too
        executeRequired(inner);
        return;
    }
    if (const auto stitched = boost::dynamic_pointer_cast<StitchedMedia>(media_))
        scaleTrackEditRate(*this, stitched->track(), scale_, !partOfTrack_);
}

boost::shared_ptr<ScaleHotspotEditRateCmd> ScaleHotspotEditRateCmd::create(const MediaPtr& media,
                                                                           const SafeRational& factor) {
    const boost::shared_ptr<ScaleHotspotEditRateCmd> command(
        new ScaleHotspotEditRateCmd(media, EditRateScale(factor)));
    command->setName("Scale Hotspot Edit Rate");
    return command;
}

bool ScaleHotspotEditRateCmd::execute(CommandHandler*) {
    const auto visual = boost::dynamic_pointer_cast<VisualMediaImpl>(media_);
    const boost::optional<HotspotInfo> hotspot = visual ? visual->hotspot() : boost::none;
    if (!hotspot) return false;
    saved_ = *hotspot;
    HotspotInfo scaled = *hotspot;
    scaled.gotoTime = scale_.tick(scaled.gotoTime);
    scaled.markerTime = scale_.tick(scaled.markerTime);
    scaled.lastMarkerGlobalTime = scale_.tick(scaled.lastMarkerGlobalTime);
    visual->setHotspot(scaled);
    return true;
}

bool ScaleHotspotEditRateCmd::unexecute(CommandHandler*) {
    boost::dynamic_pointer_cast<VisualMediaImpl>(media_)->setHotspot(saved_);
    return true;
}

} // namespace VelaMediaLib
