#include <VelaMediaLib/document/PasteClippingCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/LoadSourceCmd.h>
#include <VelaMediaLib/commands/edits/detail/SourceCommandSupport.h>
#include <VelaMediaLib/document/ClippingParser.h>
#include <VelaMediaLib/document/CopyRangeClippingCmd.h>
#include <VelaMediaLib/model/source/Source.h>

#include <sstream>

namespace VelaMediaLib {
namespace {

void checkTargets(const std::vector<TrackPtr>& tracks, VelaTime time) {
    if (tracks.empty()) throw VelaMediaLibException("a paste needs tracks to paste onto");
    for (const TrackPtr& track : tracks)
        if (!track) throw VelaMediaLibException("a paste needs tracks to paste onto");
    if (time < 0) throw VelaMediaLibException("a paste needs a time at or after 0");
}

// The clipping's one mixer, read into the project without changing it.
MixerPtr readClipping(ClippingParser& parser, const std::string& text) {
    std::istringstream in(text);
    parser.read(in);
    if (parser.clippings().size() != 1)
        throw VelaMediaLibException("a paste takes a document of one clipping");
    return parser.clippings().front();
}

} // namespace

boost::shared_ptr<PasteClippingCmd> PasteClippingCmd::create(const std::string& clippingText,
                                                             const std::vector<TrackPtr>& tracks,
                                                             VelaTime time) {
    checkTargets(tracks, time);
    const boost::shared_ptr<PasteClippingCmd> command(new PasteClippingCmd(clippingText, tracks, time));
    command->setName("Paste");
    return command;
}

bool PasteClippingCmd::execute(CommandHandler* handler) {
    pasted_.clear();
    if (MultiCommand::execute(handler) && numUndoCommands() > 0) return true;
    pasted_.clear();
    return false;
}

void PasteClippingCmd::executeCommands(const CommandHandler*) {
    const ProjectPtr project = projectForSourceCommand(handler());
    CopyRangeClippingCmd::checkTracksOf(*project, tracks_);
    ClippingParser parser(project);
    const Mixer::Tracks from = readClipping(parser, text_)->tracks();
    // Everything is checked before the first change.
    for (size_t index = tracks_.size(); index < from.size(); ++index)
        if (from[index]->numMedias() > 0)
            throw VelaMediaLibException("the clipping has more tracks than the paste was given");
    for (const SourcePtr& source : parser.newSources())
        if (!executeRequired(LoadSourceCmd::create(source))) return;
    for (size_t index = 0; index < from.size() && index < tracks_.size(); ++index)
        for (const MediaPtr& media : from[index]->medias()) {
            const VelaTime start = time_ + media->startTime();
            from[index]->removeMedia(media); // off the read track, keeping its transitions
            if (!executeRequired(AddMediaCmd::create(tracks_[index], media, start))) return;
            pasted_.push_back(media);
        }
}

boost::shared_ptr<CopyRangeAndPasteCmd> CopyRangeAndPasteCmd::create(const std::vector<TrackPtr>& tracks,
                                                                     const Range<VelaTime>& range,
                                                                     VelaTime time,
                                                                     const std::vector<TrackPtr>& targets) {
    CopyRangeClippingCmd::checkArguments(tracks, range);
    const std::vector<TrackPtr>& onto = targets.empty() ? tracks : targets;
    checkTargets(onto, time);
    const boost::shared_ptr<CopyRangeAndPasteCmd> command(
        new CopyRangeAndPasteCmd(tracks, range, time, onto));
    command->setName("Copy and Paste");
    return command;
}

bool CopyRangeAndPasteCmd::execute(CommandHandler* handler) {
    pasted_.clear();
    if (MultiCommand::execute(handler) && numUndoCommands() > 0) return true;
    pasted_.clear();
    return false;
}

void CopyRangeAndPasteCmd::executeCommands(const CommandHandler*) {
    const ProjectPtr project = projectForSourceCommand(handler());
    const std::string text = CopyRangeClippingCmd::clippingDocument(*project, tracks_, range_);
    const boost::shared_ptr<PasteClippingCmd> paste = PasteClippingCmd::create(text, targets_, time_);
    if (executeRequired(paste)) pasted_ = paste->pastedMedias();
}

} // namespace VelaMediaLib
