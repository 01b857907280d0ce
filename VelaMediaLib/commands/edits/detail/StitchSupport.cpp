#include <VelaMediaLib/commands/edits/detail/StitchSupport.h>

#include <VelaMediaLib/model/media/RationalMediaEditor.h>

#include <cstdlib>

namespace VelaMediaLib {
namespace detail {

void restoreExactly(const MediaPtr& media, const MediaState& state) {
    media->restoreState(state, std::abs(RationalMediaEditor::durationFor(state.mediaDuration, state.scalar) -
                                        state.duration));
}

bool StitchPartsCmd::execute(CommandHandler*) {
    partStates_.clear();
    for (const MediaPtr& part : parts_) partStates_.push_back(part->state());
    stitchedState_ = stitched_->state();
    std::vector<MediaPtr> touched = parts_;
    touched.push_back(stitched_);
    slots_.take(touched);
    const TransitionPtr left = parts_.front()->leftTransition(), right = parts_.back()->rightTransition();
    bool stitched = false;
    try {
        parts_.front()->setLeftTransition(TransitionPtr());
        parts_.back()->setRightTransition(TransitionPtr());
        stitched_->addMedias(parts_);
        stitched = true;
        stitched_->setLeftTransition(left);
        stitched_->setRightTransition(right);
    } catch (...) {
        // An observer may refuse after the parts went in: take them out again.
        if (stitched) takePartsOut();
        slots_.restore();
        throw;
    }
    return true;
}

void StitchPartsCmd::takePartsOut() {
    stitched_->removeAllMedias();
    for (size_t i = 0; i < parts_.size(); ++i) restoreExactly(parts_[i], partStates_[i]);
    restoreExactly(stitched_, stitchedState_);
}

bool StitchPartsCmd::unexecute(CommandHandler*) {
    takePartsOut();
    slots_.restore();
    return true;
}

namespace {

// Whether the end parts, placed as they will be, keep the room the stitched
// clip's transitions need (a tick less than their length, as a trimmed clip
// keeps); asked before anything is taken out.
bool endsHaveRoom(const std::vector<StitchedMedia::Placement>& placements, const TransitionPtr& left,
                  const TransitionPtr& right) {
    const auto length = &Transition::lengthOf;
    const StitchedMedia::Placement &first = placements.front(), &last = placements.back();
    if (first.media == last.media)
        return first.state.duration >= Transition::minimumTrackDuration(length(left), length(right));
    return first.state.duration >=
               Transition::minimumTrackDuration(length(left), length(first.media->rightTransition())) &&
           last.state.duration >=
               Transition::minimumTrackDuration(length(last.media->leftTransition()), length(right));
}

} // namespace

bool UnstitchPartsCmd::execute(CommandHandler*) {
    placements_ = stitched_->placementsWherePlayed();
    if (placements_.empty())
        throw VelaMediaLibException("a stitched media that plays no part cannot be unstitched");
    parts_ = stitched_->medias();
    partStates_.clear();
    for (const MediaPtr& part : parts_) partStates_.push_back(part->state());
    std::vector<MediaPtr> touched = parts_;
    touched.push_back(stitched_);
    slots_.take(touched);
    const TransitionPtr left = stitched_->leftTransition(), right = stitched_->rightTransition();
    if (!endsHaveRoom(placements_, left, right)) return false;
    stitched_->removeAllMedias();
    try {
        for (const StitchedMedia::Placement& placement : placements_)
            restoreExactly(placement.media, placement.state);
        stitched_->setLeftTransition(TransitionPtr());
        stitched_->setRightTransition(TransitionPtr());
        placements_.front().media->setLeftTransition(left);
        placements_.back().media->setRightTransition(right);
    } catch (...) {
        putBack();
        throw;
    }
    return true;
}

void UnstitchPartsCmd::putBack() {
    for (size_t i = 0; i < parts_.size(); ++i) {
        restoreExactly(parts_[i], partStates_[i]);
        stitched_->addMediaWhileParsing(parts_[i]);
    }
    slots_.restore();
}

bool UnstitchPartsCmd::unexecute(CommandHandler*) {
    putBack();
    return true;
}

} // namespace detail
} // namespace VelaMediaLib
