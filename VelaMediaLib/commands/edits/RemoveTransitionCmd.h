#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/AddTransitionCmd.h>

namespace VelaMediaLib {

/// Takes a transition off the clips of the track it stands on (both, when
/// two share it). Refused (false) for a transition on no clip or on a clip
/// that is not on the track.
class VELAMEDIALIB_API RemoveTransitionCmd : public TransitionEditCmd {
public:
    static boost::shared_ptr<RemoveTransitionCmd> create(const TrackPtr& track,
                                                         const TransitionPtr& transition);
    bool execute(CommandHandler* handler) override;

private:
    RemoveTransitionCmd(const TrackPtr& track, const TransitionPtr& transition)
        : TransitionEditCmd(track), transition_(transition) {}
    TransitionPtr transition_;
};

/// Puts another transition in every slot the first one holds. Refused
/// (false) as RemoveTransitionCmd is, and for a replacement already on a clip
/// or longer than a clip it would stand on.
class VELAMEDIALIB_API ReplaceTransitionCmd : public TransitionEditCmd {
public:
    static boost::shared_ptr<ReplaceTransitionCmd>
    create(const TrackPtr& track, const TransitionPtr& transition, const TransitionPtr& replacement);
    bool execute(CommandHandler* handler) override;

private:
    ReplaceTransitionCmd(const TrackPtr& track, const TransitionPtr& transition,
                         const TransitionPtr& replacement)
        : TransitionEditCmd(track), transition_(transition), replacement_(replacement) {}
    TransitionPtr transition_, replacement_;
};

/// Parts a transition two touching clips share: the earlier clip keeps it on
/// its right edge, the later one takes a copy on its left (the same copy on
/// every redo, so that later edits of it redo too). Refused (false) for a
/// transition that is not shared by two clips of the track.
class VELAMEDIALIB_API SplitTransitionCmd : public TransitionEditCmd {
public:
    static boost::shared_ptr<SplitTransitionCmd> create(const TrackPtr& track,
                                                        const TransitionPtr& transition);
    bool execute(CommandHandler* handler) override;

private:
    SplitTransitionCmd(const TrackPtr& track, const TransitionPtr& transition)
        : TransitionEditCmd(track), transition_(transition) {}
    TransitionPtr transition_;
    TransitionPtr copy_; // made by the first execution
};

/// Gives a transition a new length. Refused (false) for the length it has
/// (nothing to do, no step), a length below zero or longer than a clip it stands on, or a transition on a
/// clip of another track; one on no clip takes any length from zero. Undo gives back the length it had.
class VELAMEDIALIB_API TrimTransitionCmd : public TransitionEditCmd {
public:
    static boost::shared_ptr<TrimTransitionCmd> create(const TrackPtr& track, const TransitionPtr& transition,
                                                       VelaTime duration);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    /// Gives the length again, asking for no room (it follows the undo).
    bool reexecute(CommandHandler* handler) override;

private:
    void setLength(VelaTime duration);
    TrimTransitionCmd(const TrackPtr& track, const TransitionPtr& transition, VelaTime duration)
        : TransitionEditCmd(track), transition_(transition), duration_(duration) {}
    TransitionPtr transition_;
    VelaTime duration_;
    VelaTime saved_ = 0;
};

} // namespace VelaMediaLib
