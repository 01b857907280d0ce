#include <VelaMediaLib/commands/edits/ExtendFrameCmd.h>

#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/ExtendMediaCmd.h>
#include <VelaMediaLib/commands/edits/ExtendTracksCmd.h>
#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>
#include <VelaMediaLib/commands/edits/SplitCmd.h>
#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/IMFile.h>
#include <VelaMediaLib/model/media/ScreenIMFile.h>
#include <VelaMediaLib/model/media/VisualMedia.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

namespace VelaMediaLib {

boost::shared_ptr<ExtendFrameCmd> ExtendFrameCmd::create(const MediaPtr& media, VelaTime time,
                                                         VelaTime duration, bool ripple,
                                                         bool rippleOtherTracks) {
    if (!boost::dynamic_pointer_cast<VisualMedia>(media))
        throw VelaMediaLibException("only a visual clip has a frame to extend");
    if (duration <= 0)
        throw ValueException<long long>("an extended frame must be longer than zero", duration);
    if (rippleOtherTracks && !ripple)
        throw VelaMediaLibException("only a rippling edit changes other tracks");
    const boost::shared_ptr<ExtendFrameCmd> command(
        new ExtendFrameCmd(media, time, duration, ripple, rippleOtherTracks));
    command->setName("Extend Frame");
    return command;
}

namespace {

const char* const noStill = "the clip's source has no still image";

// The stream of the source a still plays: the clip's own when it is one,
// else the first image stream of the file.
int stillStream(const Source& source, int own, bool& screen) {
    const boost::shared_ptr<MediaFileStats> stats = source.stats();
    const auto isStill = [&](int index) {
        const TrackType type = stats->trackStats(index).type;
        screen = type == TrackType::ScreenImage;
        return type == TrackType::Image || screen;
    };
    if (own < source.numTracks() && isStill(own)) return own;
    for (int index = 0; index < source.numTracks(); ++index)
        if (isStill(index)) return index;
    throw VelaMediaLibException(noStill);
}

} // namespace

MediaPtr ExtendFrameCmd::createAbstractIMFile(const Media& media, VelaTime time, VelaTime duration) {
    const FileMedia* const file = dynamic_cast<const FileMedia*>(&media);
    const boost::shared_ptr<const Source> source = file ? file->source() : boost::shared_ptr<const Source>();
    if (!source) throw VelaMediaLibException(noStill);
    bool screen = false;
    const int stream = stillStream(*source, file->streamIndex(), screen);
    const MediaState playing = media.state();
    const SourceLink link = SourceLink::holding(source, stream);
    MediaState state = AbstractIMFile::stillState(
        link, screen ? ScreenIMFile::playsStream : IMFile::playsStream, 0, duration);
    state.mediaStart = playing.mediaStart + SafeRational(time - playing.start) / playing.scalar;
    if (screen) return ScreenIMFile::create(link, state);
    return IMFile::create(link, state);
}

MediaPtr ExtendFrameCmd::createExtendedGroupFrame(const Group& group, VelaTime time, VelaTime duration) {
    const MediaState playing = group.state();
    // The group's media time is its mixer's time.
    const SafeRational inner = playing.mediaStart + SafeRational(time - playing.start) / playing.scalar;
    const boost::shared_ptr<GenericMixer> mixer = GenericMixer::create(group.projectMutex());
    for (const TrackPtr& track : group.mixer()->tracks()) {
        const VelaTime at = inner.asVelaTime();
        const Track::Pair found = track->mediaAtTime(at);
        const MediaPtr& clip = found.second ? found.second : found.first;
        if (!clip || !boost::dynamic_pointer_cast<VisualMedia>(clip)) continue;
        MediaPtr still;
        try {
            still = createFrame(*clip, at, duration);
        } catch (const VelaMediaLibException&) {
            continue; // a clip without a still shows nothing in the frame
        }
        const boost::shared_ptr<GenericTrack> stills = GenericTrack::create(group.projectMutex());
        stills->addMedia(still, 0);
        mixer->addTrack(stills);
    }
    if (mixer->tracks().empty()) throw VelaMediaLibException(noStill);
    const boost::shared_ptr<Group> frame =
        Group::create(group.projectMutex(), group.projectEditRate(), mixer, 0);
    frame->setGroupWidthAndHeight(group.width(), group.height());
    return frame;
}

MediaPtr ExtendFrameCmd::createFrame(const Media& media, VelaTime time, VelaTime duration) {
    if (const Group* group = Group::asGroup(&media)) return createExtendedGroupFrame(*group, time, duration);
    return createAbstractIMFile(media, time, duration);
}

bool ExtendFrameCmd::execute(CommandHandler* handler) {
    created_.reset();
    following_.reset();
    leading_.reset();
    if (MultiCommand::execute(handler) && numUndoCommands() > 0) return true;
    created_.reset();
    following_.reset();
    leading_.reset();
    return false;
}

TrackPtr ExtendFrameCmd::checkedTrack() const {
    TrackPtr track;
    media_->parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
        track = boost::dynamic_pointer_cast<Track>(parent);
    });
    if (!track) throw VelaMediaLibException("the clip is on no track");
    const Range<VelaTime> range = media_->trackRange();
    if (time_ < range.start() || time_ >= range.end())
        throw VelaMediaLibException("the time is outside the clip");
    return track;
}

bool ExtendFrameCmd::extendOtherTracks(const TrackPtr& track) {
    const boost::shared_ptr<Mixer> mixer = track->parentMixer();
    if (!mixer) return true;
    const boost::shared_ptr<ExtendTracksCmd> open = ExtendTracksCmd::create(time_, duration_);
    for (const TrackPtr& other : mixer->tracks())
        if (other != track) open->addTrack(other);
    // Other tracks with nothing from the time on have nothing to open.
    return open->tracks().empty() || !open->changesAnything() || executeRequired(open);
}

void ExtendFrameCmd::executeCommands(const CommandHandler*) {
    track_ = checkedTrack();
    const TrackPtr& track = track_;
    const MediaPtr still = createFrame(*media_, time_, duration_);
    if (ripple_ && rippleOtherTracks_ && !extendOtherTracks(track)) return;
    following_ = media_;
    if (time_ > media_->trackRange().start()) {
        const boost::shared_ptr<SplitCmd> split = SplitCmd::create(track, time_);
        if (!executeRequired(split)) return;
        leading_ = media_;
        following_ = split->getCreatedMedias().front();
    }
    if (ripple_) {
        if (!executeRequired(RippleMoveCmd::create(track, following_, duration_))) return;
    } else if (!executeRequired(ReduceMediaCmd::create(following_, duration_, 0))) {
        return;
    }
    if (executeRequired(AddMediaCmd::create(track, still, time_))) created_ = still;
}

} // namespace VelaMediaLib
