#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>

#include <vector>

namespace VelaMediaLib {

/// What the transition edits share: each acts on the slots of clips of one
/// track and undoes by giving every clip around the ones it touched its slots
/// back, and every transition its clips, exactly as they were.
class VELAMEDIALIB_API TransitionEditCmd : public Command {
public:
    enum Side { Left, Right };
    bool unexecute(CommandHandler* handler) override;
    /// Puts back the slots and links the edit gave, exactly and asking for
    /// no room: a redo follows the undo of the same edit.
    bool reexecute(CommandHandler* handler) override;

protected:
    explicit TransitionEditCmd(const TrackPtr& track) : track_(track) {}
    /// Takes the slots of the clips (and of the clips their transitions name).
    void saveSlots(const std::vector<MediaPtr>& clips);
    /// Takes the same slots as the edit left them, for the redo; true.
    bool done();
    /// Whether every clip is on the track (held under one read lock).
    bool onTrack(const std::vector<MediaPtr>& clips) const;
    TrackPtr track_;

private:
    std::vector<MediaPtr> recorded_; // the clips whose slots are kept
    TransitionSlots slots_, after_;
};

/// Puts a transition on one edge of a clip of the track. Where a clip
/// touches that edge, the two share it. Refused (false) for a clip not on
/// the track, a transition already on a clip, an edge (or the touching
/// clip's facing edge) that has a transition, or a length below zero or
/// more than a clip it would stand on has beside its other transition.
class VELAMEDIALIB_API AddTransitionCmd : public TransitionEditCmd {
public:
    static boost::shared_ptr<AddTransitionCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                      const TransitionPtr& transition, Side side);
    /// Whether the transition could be put there now.
    static bool fits(const Track& track, const MediaPtr& media, const TransitionPtr& transition, Side side);
    bool execute(CommandHandler* handler) override;

private:
    AddTransitionCmd(const TrackPtr& track, const MediaPtr& media, const TransitionPtr& transition, Side side)
        : TransitionEditCmd(track), media_(media), transition_(transition), side_(side) {}
    MediaPtr media_;
    TransitionPtr transition_;
    Side side_;
};

/// Puts a copy of a transition on every free edge of the clips where it fits
/// (one copy for two touching clips), each with an AddTransitionCmd. Edges
/// that have a transition, or where it does not fit, are passed over; when
/// no edge takes one the command is refused (false).
class VELAMEDIALIB_API AddTransitionToMediasCmd : public MultiCommand {
public:
    static boost::shared_ptr<AddTransitionToMediasCmd>
    create(const TrackPtr& track, const std::vector<MediaPtr>& medias, const TransitionPtr& transition);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    AddTransitionToMediasCmd(const TrackPtr& track, const std::vector<MediaPtr>& medias,
                             const TransitionPtr& transition)
        : track_(track), medias_(medias), transition_(transition) {}
    TrackPtr track_;
    std::vector<MediaPtr> medias_;
    TransitionPtr transition_;
};

} // namespace VelaMediaLib
