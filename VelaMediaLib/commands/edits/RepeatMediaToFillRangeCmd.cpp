#include <VelaMediaLib/commands/edits/RepeatMediaToFillRangeCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/CloneAddMediasCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<RepeatMediaToFillRangeCmd> RepeatMediaToFillRangeCmd::create(const TrackPtr& track,
                                                                               const MediaPtr& media,
                                                                               const Range<VelaTime>& range) {
    if (!track || !media) throw VelaMediaLibException("repeating a clip needs a track and a clip");
    if (range.duration() <= 0) throw VelaMediaLibException("a range to fill must be longer than zero");
    const boost::shared_ptr<RepeatMediaToFillRangeCmd> command(
        new RepeatMediaToFillRangeCmd(track, media, range));
    command->setName("Repeat Media to Fill Range");
    return command;
}

bool RepeatMediaToFillRangeCmd::execute(CommandHandler* handler) {
    created_.clear();
    if (MultiCommand::execute(handler)) return true;
    created_.clear();
    return false;
}

// The copies are new: cutting the last one off any track is no edit of the
// project's, and undoing its placement takes it away whole.
void RepeatMediaToFillRangeCmd::executeCommands(const CommandHandler*) {
    for (VelaTime at = range_.start(); at < range_.end();) {
        const MediaPtr copy = CloneAddMediasCmd::placeableClone(*media_);
        const VelaTime excess = at + copy->duration() - range_.end();
        if (excess > 0) copy->trimEnd(excess);
        if (!executeRequired(AddMediaCmd::create(track_, copy, at))) return;
        created_.push_back(copy);
        at += copy->duration();
    }
}

} // namespace VelaMediaLib
