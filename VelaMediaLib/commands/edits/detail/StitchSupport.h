#pragma once
// The steps inside the stitch commands that move clips into and out of a
// stitched media: they act on the stitched media directly (its internal track
// is no track of the project) and undo by giving back exact states.

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>

#include <vector>

namespace VelaMediaLib {
namespace detail {

/// Gives clips taken off their track to the stitched media as its parts; the
/// first part's left and the last part's right transition go to the
/// stitched media's edges. Undone, the clips have their states and slots back
/// and the stitched media is empty as before.
class StitchPartsCmd : public Command {
public:
    StitchPartsCmd(const boost::shared_ptr<StitchedMedia>& stitched, const std::vector<MediaPtr>& parts)
        : stitched_(stitched), parts_(parts) {}
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

private:
    void takePartsOut();
    boost::shared_ptr<StitchedMedia> stitched_;
    std::vector<MediaPtr> parts_;
    std::vector<MediaState> partStates_;
    MediaState stitchedState_;
    TransitionSlots slots_;
};

/// Takes the parts out of a stitched media taken off its track, each part it
/// plays given the state that plays on that track what the stitched media
/// played of it (the stitched media's edge transitions go to the first and
/// last of them). Refused (false, nothing changed) where an end part would be
/// too short for the transition it takes. Undone, the parts are back inside
/// as they were.
class UnstitchPartsCmd : public Command {
public:
    explicit UnstitchPartsCmd(const boost::shared_ptr<StitchedMedia>& stitched) : stitched_(stitched) {}
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    /// The parts played, where they play, from the last execute.
    const std::vector<StitchedMedia::Placement>& placements() const { return placements_; }

private:
    void putBack();

    boost::shared_ptr<StitchedMedia> stitched_;
    std::vector<MediaPtr> parts_;
    std::vector<MediaState> partStates_;
    std::vector<StitchedMedia::Placement> placements_;
    TransitionSlots slots_;
};

/// A restore that allows the rounding the state already has.
void restoreExactly(const MediaPtr& media, const MediaState& state);

} // namespace detail
} // namespace VelaMediaLib
