#include <VelaMediaLib/commands/edits/StitchingExtendFrameCmd.h>

#include <VelaMediaLib/commands/edits/ExtendMediaCmd.h>
#include <VelaMediaLib/commands/edits/StitchMediaCmd.h>
#include <VelaMediaLib/commands/edits/StretchCmd.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/model/timeline/Mixer.h>

namespace VelaMediaLib {

boost::shared_ptr<StitchingExtendFrameCmd>
StitchingExtendFrameCmd::create(const MediaPtr& media, const std::string& name, VelaTime time,
                                VelaTime duration, VelaTime trim, const SafeRational& scalar,
                                bool rippleOtherTracks) {
    ExtendFrameCmd::create(media, time, duration, true, rippleOtherTracks); // checks the same
    if (trim < 0) throw ValueException<long long>("a trim must not be negative", trim);
    if (scalar <= SafeRational(0)) throw VelaMediaLibException("a clip's scalar must be above zero");
    const boost::shared_ptr<StitchingExtendFrameCmd> command(
        new StitchingExtendFrameCmd(media, time, duration, trim, scalar, rippleOtherTracks));
    command->setName(name.empty() ? "Stitching Extend Frame" : name);
    return command;
}

bool StitchingExtendFrameCmd::execute(CommandHandler* handler) {
    stitched_.reset();
    if (ExtendFrameCmd::execute(handler)) return true;
    stitched_.reset();
    return false;
}

void StitchingExtendFrameCmd::executeCommands(const CommandHandler* handler) {
    ExtendFrameCmd::executeCommands(handler);
    if (!created_) return; // refused
    const TrackPtr& track = track_;
    if (trim_ > 0) {
        MultiTrackEditOptions options;
        const boost::shared_ptr<Mixer> mixer =
            rippleOtherTracks_ ? track->parentMixer() : boost::shared_ptr<Mixer>();
        if (mixer)
            for (const TrackPtr& other : mixer->tracks())
                if (other != track) options.tracks.push_back(other);
        if (!executeRequired(ReduceMediaCmd::create(following_, trim_, 0, options, true))) return;
    }
    std::vector<MediaPtr> parts;
    if (leading_) parts.push_back(leading_);
    parts.push_back(created_);
    parts.push_back(following_);
    const boost::shared_ptr<StitchMediaCmd> stitch = StitchMediaCmd::create(track, parts);
    if (!executeRequired(stitch)) return;
    if (scalar_ != SafeRational(1) && !executeRequired(StretchCmd::create(stitch->stitchedMedia(), scalar_)))
        return;
    stitched_ = stitch->stitchedMedia();
}

} // namespace VelaMediaLib
