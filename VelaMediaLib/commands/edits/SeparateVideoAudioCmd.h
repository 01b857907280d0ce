#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

class UnifiedMedia;

/// A step of the commands that take a unified clip apart, once it is off
/// its track: the clip lets go of its parts, and its visual part takes its
/// transitions (the visual part takes its place on the track). Undo gives
/// the transitions back, links included, and the clip takes its parts back.
/// Refuses (false) a clip still placed or apart already.
class VELAMEDIALIB_API ReleaseInternalsCmd : public Command {
public:
    static boost::shared_ptr<ReleaseInternalsCmd> create(const boost::shared_ptr<UnifiedMedia>& unified);
    bool execute(CommandHandler* handler) override;
    /// Throws as UnifiedMedia::adoptInternals when a part still lies on a track.
    bool unexecute(CommandHandler* handler) override;

private:
    explicit ReleaseInternalsCmd(const boost::shared_ptr<UnifiedMedia>& unified) : unified_(unified) {}
    struct Link {
        TransitionPtr transition;
        boost::weak_ptr<Media> left, right;
    };

    boost::shared_ptr<UnifiedMedia> unified_;
    TransitionPtr unifiedLeft_, unifiedRight_, visualLeft_, visualRight_; // the slots before
    std::vector<Link> links_;                                             // of those transitions, before
};

/// Separates a unified clip into its parts: the visual part takes the clip's
/// place on its track, the audio part stands at the same time on the audio
/// track, so the two stay in sync. Without an audio track given, it goes on
/// a new track made right after the clip's track in its mixer (undo takes
/// that track away again). Undo puts the unified clip back with its parts,
/// exactly. All or nothing: a clip not on the track, or a collision on the
/// audio track, refuses the whole command (false, nothing changed).
class VELAMEDIALIB_API SeparateVideoAudioCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for no track, TypeException when the clip
    /// is not a unified media, and AddRemoveException when the audio track is
    /// the clip's own.
    static boost::shared_ptr<SeparateVideoAudioCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                           const TrackPtr& audioTrack = TrackPtr());
    /// The track the audio part went to: the one given, or the one made once
    /// the command has run.
    const TrackPtr& audioTrack() const { return audioTrack_; }

    /// The unified clip of a command's arguments, checked (the exceptions of create).
    static boost::shared_ptr<UnifiedMedia> unifiedOf(const TrackPtr& track, const MediaPtr& media);

protected:
    /// Throws VelaMediaLibException when a new track is needed and the clip's
    /// track lies in no mixer.
    void executeCommands(const CommandHandler* handler) override;

private:
    SeparateVideoAudioCmd(const TrackPtr& track, const boost::shared_ptr<UnifiedMedia>& unified,
                          const TrackPtr& audioTrack)
        : track_(track), unified_(unified), audioTrack_(audioTrack) {}
    TrackPtr newAudioTrack();

    TrackPtr track_;
    boost::shared_ptr<UnifiedMedia> unified_;
    TrackPtr audioTrack_;
};

} // namespace VelaMediaLib
