#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>

namespace VelaMediaLib {

/// Puts a new, empty track into a mixer at an index (-1 appends). The track
/// is made on the first run; undo takes it out and redo puts the same track
/// back. An index outside -1 … number of tracks throws ValueException<int>
/// "invalid index", changing nothing.
class VELAMEDIALIB_API NewTrackCmd : public Command {
public:
    /// Throws TypeException for a mixer that is not a GenericMixer (or none).
    static boost::shared_ptr<NewTrackCmd> create(const MixerPtr& mixer, int index = -1);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    /// The track made, once the command has run.
    const TrackPtr& track() const { return track_; }

private:
    NewTrackCmd(const boost::shared_ptr<GenericMixer>& mixer, int index) : mixer_(mixer), index_(index) {}

    boost::shared_ptr<GenericMixer> mixer_;
    int index_;
    TrackPtr track_;
};

/// Takes a track, with its clips and flags, out of its mixer; undo puts the
/// same track back at the index it had. Mixer and timeline observers hear
/// both ways, so a magnetic track keeps its magnetizer after the undo.
class VELAMEDIALIB_API RemoveTrackCmd : public Command {
public:
    /// Throws AddRemoveException "the track is not in this mixer" (or TypeException
    /// for a mixer that is not a GenericMixer).
    static boost::shared_ptr<RemoveTrackCmd> create(const MixerPtr& mixer, const TrackPtr& track);
    /// False, changing nothing, when the mixer no longer holds the track.
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    const RemoveTrackInfo& info() const { return info_; }

private:
    RemoveTrackCmd(const boost::shared_ptr<GenericMixer>& mixer, const TrackPtr& track)
        : mixer_(mixer), track_(track) {}

    boost::shared_ptr<GenericMixer> mixer_;
    TrackPtr track_;
    RemoveTrackInfo info_;
};

/// Swaps the places of two tracks of a mixer; its own inverse.
class VELAMEDIALIB_API SwapTrackOrderCmd : public Command {
public:
    /// Throws AddRemoveException "the track is not in this mixer" for a track
    /// the mixer does not hold, and ValueException<int> "cannot swap a track with itself".
    static boost::shared_ptr<SwapTrackOrderCmd> create(const MixerPtr& mixer, const TrackPtr& first,
                                                       const TrackPtr& second);
    /// False, changing nothing, when the mixer no longer holds both tracks.
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override { return execute(handler); }

private:
    SwapTrackOrderCmd(const MixerPtr& mixer, const TrackPtr& first, const TrackPtr& second)
        : mixer_(mixer), first_(first), second_(second) {}

    MixerPtr mixer_;
    TrackPtr first_, second_;
};

} // namespace VelaMediaLib
