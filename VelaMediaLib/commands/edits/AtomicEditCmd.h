#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/commands/edits/CommandHandler.h>

#include <vector>

namespace VelaMediaLib {

/// The transitions of a few clips as they were: each clip's two slots and
/// the clips each of those transitions named. Placing a clip joins
/// transitions with its touching neighbours (and placing it back does so
/// again), so an undo puts back what was taken and transitions come back
/// exactly. Clips without any transition among them take no room.
class TransitionSlots {
public:
    /// Takes the clip and the clips of the track touching or inside the range
    /// (where placing the clip joins transitions). Unless `always`, clips
    /// without any transition among them are not kept (placing joins nothing
    /// there); an edit that sets slots itself keeps them always.
    void takeAround(const Track& track, const MediaPtr& media, const Range<VelaTime>& range,
                    bool always = false);
    /// Takes the given clips (all of one project), whatever they hold.
    void take(const std::vector<MediaPtr>& clips);
    /// Puts back every slot, then every link, taken.
    void restore() const;
    /// Whether every slot and link taken is still as it was.
    bool standsAsTaken() const;

private:
    struct Slots {
        boost::weak_ptr<Media> media;
        TransitionPtr left, right;
    };
    struct Links {
        TransitionPtr transition;
        boost::weak_ptr<Media> left, right;
    };
    void takeLocked(const std::vector<MediaPtr>& clips);
    void addSlots(const MediaPtr& clip, bool withLinks);
    void addLinks(const TransitionPtr& transition);

    boost::weak_ptr<const ThreadSafe> token_;
    std::vector<Slots> clips_;
    std::vector<Links> links_;
};

/// An edit of one clip on one track by a tick amount, carried out through the
/// handler. It keeps the track and clip the handler answered, since an edit
/// may replace the clip; a refused edit reports false. Timing edits undo by
/// giving the clip back the state it had before, exactly: the inverse edit
/// cannot always (a trim back by the same delta may round past the media's end).
/// Adding and removing also give back the transitions of the clip and of its
/// touching neighbours where it is placed, since placing joins them. Timing
/// edits change no transition slot or link (the track joins transitions only
/// when placing a clip, and leaves parted clips their slots, returning the
/// pair it parted), so giving back the timing gives back everything. Without a
/// handler (a composite's inner history used between runs) it throws
/// VelaMediaLibException "no command handler".
class VELAMEDIALIB_API AtomicEditCmd : public Command {
public:
    const TrackPtr& track() const { return track_; }
    const MediaPtr& media() const { return media_; }
    VelaTime amount() const { return amount_; }
    const TrackPtr& resultTrack() const { return resultTrack_; }
    const MediaPtr& resultMedia() const { return resultMedia_; }

protected:
    AtomicEditCmd(const TrackPtr& track, const MediaPtr& media, VelaTime amount)
        : track_(track), media_(media), amount_(amount), resultTrack_(track), resultMedia_(media) {}
    /// Keeps the handler's answer; true when it placed a clip.
    bool keep(const CommandHandler::TrackAndMedia& result);
    /// Takes the clip's timing before a timing edit.
    void saveState();
    /// Takes the clip's timing before it is placed at or taken off the range,
    /// and the transitions of the clips touching the range.
    void saveState(const Range<VelaTime>& placed);
    /// Gives the clip the timing and transitions it had before the edit.
    bool restoreSavedState(CommandHandler* handler);
    /// Takes the clip's timing after an edit, so that a redo gives it back
    /// exactly (and a combined edit can redo both parts in one step).
    void saveAfter() { after_ = resultMedia_ ? resultMedia_->state() : MediaState(); }
    /// Gives the clip the timing it had after the edit; false when refused.
    bool restoreAfter(CommandHandler* handler) {
        return need(handler).restoreMediaState(resultTrack_, resultMedia_, after_).second != nullptr;
    }
    /// The track the clip stands on, or null (off a track, or in a group).
    static TrackPtr parentTrackOf(const MediaPtr& media);
    /// The handler, or VelaMediaLibException "no command handler".
    static CommandHandler& need(CommandHandler* handler);

    TrackPtr track_;
    MediaPtr media_;
    VelaTime amount_;
    TrackPtr resultTrack_;
    MediaPtr resultMedia_;
    MediaState saved_;
    MediaState after_;
    TransitionSlots slots_;
};

/// Moves a clip on its track by a tick delta. Two moves of the same clip
/// combine into one move by the sum, undone to the first one's saved state.
class VELAMEDIALIB_API MoveCmd : public AtomicEditCmd {
public:
    static boost::shared_ptr<MoveCmd> create(const TrackPtr& track, const MediaPtr& media, VelaTime delta);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    CommandPtr combine(const CommandPtr& later) override;

private:
    MoveCmd(const TrackPtr& track, const MediaPtr& media, VelaTime delta)
        : AtomicEditCmd(track, media, delta) {}
};

/// Places a clip on a track at a start tick; undone by removing it, the clip
/// taking back the start it had before and, with its neighbours there, the
/// transitions they had before placing joined them. A clip too short for the
/// transitions it holds is refused (false).
class VELAMEDIALIB_API AddMediaCmd : public AtomicEditCmd {
public:
    static boost::shared_ptr<AddMediaCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                 VelaTime start);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

private:
    AddMediaCmd(const TrackPtr& track, const MediaPtr& media, VelaTime start)
        : AtomicEditCmd(track, media, start) {}
};

/// Takes a clip off its track; undone by placing it back where it was, with
/// the transitions it and its neighbours had (placing it back would join them).
class VELAMEDIALIB_API RemoveMediaCmd : public AtomicEditCmd {
public:
    static boost::shared_ptr<RemoveMediaCmd> create(const TrackPtr& track, const MediaPtr& media);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

private:
    RemoveMediaCmd(const TrackPtr& track, const MediaPtr& media) : AtomicEditCmd(track, media, 0) {}
};

} // namespace VelaMediaLib
