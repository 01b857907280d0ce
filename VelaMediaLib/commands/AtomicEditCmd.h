#pragma once

#include <VelaMediaLib/commands/Command.h>
#include <VelaMediaLib/commands/CommandHandler.h>

namespace VelaMediaLib {

/// An edit of one clip on one track by a tick amount, carried out through the
/// handler. It keeps the track and clip the handler answered, since an edit
/// may replace the clip; a refused edit reports false. Timing edits undo by
/// giving the clip back the state it had before, exactly: the inverse edit
/// cannot always (a trim back by the same delta may round past the media's end).
class AtomicEditCmd : public Command {
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
    /// Takes the clip's timing before the edit.
    void saveState();
    /// Gives the clip the timing it had before the edit.
    bool restoreSavedState(CommandHandler* handler);

    TrackPtr track_;
    MediaPtr media_;
    VelaTime amount_;
    TrackPtr resultTrack_;
    MediaPtr resultMedia_;
    MediaState saved_;
};

/// Moves a clip on its track by a tick delta. Two moves of the same clip
/// combine into one move by the sum, undone to the first one's saved state.
class MoveCmd : public AtomicEditCmd {
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
/// taking back the start it had before.
class AddMediaCmd : public AtomicEditCmd {
public:
    static boost::shared_ptr<AddMediaCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                 VelaTime start);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

private:
    AddMediaCmd(const TrackPtr& track, const MediaPtr& media, VelaTime start)
        : AtomicEditCmd(track, media, start) {}
};

/// Takes a clip off its track; undone by placing it back where it was.
class RemoveMediaCmd : public AtomicEditCmd {
public:
    static boost::shared_ptr<RemoveMediaCmd> create(const TrackPtr& track, const MediaPtr& media);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;

private:
    RemoveMediaCmd(const TrackPtr& track, const MediaPtr& media) : AtomicEditCmd(track, media, 0) {}
};

} // namespace VelaMediaLib
