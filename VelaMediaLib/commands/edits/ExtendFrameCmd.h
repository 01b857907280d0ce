#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

class Group;

/// Holds the frame a visual clip shows at a tick for a while: a still of that
/// frame (createdImageMedia) is placed at the tick for `duration` ticks, the
/// clip split there (SplitCmd) so that it plays on after the still.
/// With `ripple` (insert) the clips from the tick on move later by the
/// duration; with `rippleOtherTracks` too, the other tracks of the clip's
/// mixer open the same time (ExtendTracksCmd), staying in step. Without
/// `ripple` (overwrite) the still covers the duration of what follows the
/// tick: the part after it loses its first `duration` ticks (ReduceMediaCmd),
/// so nothing after it moves; a part not longer than that refuses it.
/// The tick must lie in the clip (its start included, its end not), the clip
/// on a track: otherwise VelaMediaLibException, nothing changed. The still
/// is the same object on every redo.
class VELAMEDIALIB_API ExtendFrameCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for a clip that is not visual, a duration
    /// not above zero, or rippleOtherTracks without ripple.
    static boost::shared_ptr<ExtendFrameCmd> create(const MediaPtr& media, VelaTime time, VelaTime duration,
                                                    bool ripple = true, bool rippleOtherTracks = false);
    /// The still the last execution placed (null before, or when refused).
    const MediaPtr& createdImageMedia() const { return created_; }
    /// The clip's part that plays on after the still (the clip itself when
    /// the tick was its start), once executed.
    const MediaPtr& followingMedia() const { return following_; }

    /// A still of the clip's frame at the tick (project ticks), standing from
    /// 0 for the duration, off any track: an image clip of the clip's own
    /// source (IMFile; ScreenIMFile for a screen-image stream), whose media
    /// start is the source time the clip plays at the tick, so that a
    /// renderer shows that frame. The library decodes nothing: a source
    /// without an image stream beside its video has no still to give
    /// (VelaMediaLibException "the clip's source has no still image").
    static MediaPtr createAbstractIMFile(const Media& media, VelaTime time, VelaTime duration);
    /// The frame of a group at the tick: a group of the same canvas holding,
    /// for each of its tracks with a visual clip at that time, a still of it
    /// (groups inside taken the same way). Throws as createAbstractIMFile
    /// when none of its clips gives a still.
    static MediaPtr createExtendedGroupFrame(const Group& group, VelaTime time, VelaTime duration);
    /// The still for either kind.
    static MediaPtr createFrame(const Media& media, VelaTime time, VelaTime duration);

    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;
    ExtendFrameCmd(const MediaPtr& media, VelaTime time, VelaTime duration, bool ripple,
                   bool rippleOtherTracks)
        : media_(media), track_(), time_(time), duration_(duration), ripple_(ripple),
          rippleOtherTracks_(rippleOtherTracks) {}
    /// The clip's track, checked as create says.
    TrackPtr checkedTrack() const;

    MediaPtr media_;
    TrackPtr track_; // the clip's, while executing
    VelaTime time_;
    VelaTime duration_;
    bool ripple_;
    bool rippleOtherTracks_;
    MediaPtr created_;
    MediaPtr following_;
    MediaPtr leading_;

private:
    /// Opens the duration at the tick on the mixer's other tracks.
    bool extendOtherTracks(const TrackPtr& track);
};

} // namespace VelaMediaLib
