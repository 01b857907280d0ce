#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

namespace VelaMediaLib {

/// Gives a clip a whole timing state through the handler (restoreMediaState:
/// the clip's checks and the track's collision test apply); undo gives back
/// the state it had, exactly. A clip on no track, a state the clip or its
/// track refuses, or one shorter than the clip's transitions allow (see
/// Transition::minimumTrackDuration), reports false and changes nothing.
class VELAMEDIALIB_API SetMediaStateCmd : public AtomicEditCmd {
public:
    /// The clip on the track it stands on when the command runs.
    static boost::shared_ptr<SetMediaStateCmd> create(const MediaPtr& media, const MediaState& state);
    static boost::shared_ptr<SetMediaStateCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                      const MediaState& state);
    /// A state that an edit rate change rounded: the clip's transitions were
    /// rounded to ticks on their own, so their room is not asked for (a
    /// rounding may leave a clip a tick short of it; see the design notes).
    static boost::shared_ptr<SetMediaStateCmd> createRounded(const TrackPtr& track, const MediaPtr& media,
                                                             const MediaState& state);
    const MediaState& state() const { return state_; }
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override { return restoreSavedState(handler); }

private:
    SetMediaStateCmd(const TrackPtr& track, const MediaPtr& media, const MediaState& state)
        : AtomicEditCmd(track, media, 0), state_(state), findTrack_(!track) {}

    MediaState state_;
    bool findTrack_;
    bool keepRoom_ = true;
};

} // namespace VelaMediaLib
