#include <VelaMediaLib/model/timeline/CollisionException.h>
#include <VelaMediaLib/commands/edits/CommandHandler.h>

#include <VelaMediaLib/model/timeline/GenericTrack.h>

namespace VelaMediaLib {
namespace {

// Runs a track edit; the model's refusals become an empty answer. Every
// exception caught here is thrown by the model's checks before anything
// changed: add observers, told after the change, cannot throw into the edit
// (their failures are their own), so a refusal never hides a half-done edit.
template <typename Edit>
CommandHandler::TrackAndMedia attempt(const TrackPtr& track, const MediaPtr& media, Edit edit) {
    if (!track || !media) return CommandHandler::TrackAndMedia();
    try {
        edit();
    } catch (const CollisionException&) {
        return CommandHandler::TrackAndMedia();
    } catch (const InvalidTrimRangeException&) {
        return CommandHandler::TrackAndMedia();
    } catch (const AddRemoveException&) {
        return CommandHandler::TrackAndMedia();
    } catch (const ValueException<double>&) { // a stretch to nothing, or too short for its transitions
        return CommandHandler::TrackAndMedia();
    } catch (const ValueException<const SafeRational>&) { // a state the clip does not accept
        return CommandHandler::TrackAndMedia();
    }
    return CommandHandler::TrackAndMedia(track, media);
}

} // namespace

CommandHandler::TrackAndMedia
ProjectIndependentCommandHandler::moveMedia(const TrackPtr& track, const MediaPtr& media, VelaTime delta) {
    return attempt(track, media, [&] { track->move(media, delta); });
}

CommandHandler::TrackAndMedia ProjectIndependentCommandHandler::trimMediaStart(const TrackPtr& track,
                                                                               const MediaPtr& media,
                                                                               VelaTime delta) {
    return attempt(track, media, [&] { track->trimStart(media, delta); });
}

CommandHandler::TrackAndMedia
ProjectIndependentCommandHandler::trimMediaEnd(const TrackPtr& track, const MediaPtr& media, VelaTime delta) {
    return attempt(track, media, [&] { track->trimEnd(media, delta); });
}

CommandHandler::TrackAndMedia ProjectIndependentCommandHandler::stretchMedia(const TrackPtr& track,
                                                                             const MediaPtr& media,
                                                                             const SafeRational& factor) {
    return attempt(track, media, [&] { track->stretch(media, factor); });
}

CommandHandler::TrackAndMedia ProjectIndependentCommandHandler::restoreMediaState(const TrackPtr& track,
                                                                                  const MediaPtr& media,
                                                                                  const MediaState& state) {
    return attempt(track, media, [&] { track->restoreMediaState(media, state, 0); });
}

CommandHandler::TrackAndMedia
ProjectIndependentCommandHandler::addMedia(const TrackPtr& track, const MediaPtr& media, VelaTime start) {
    const boost::shared_ptr<GenericTrack> generic = boost::dynamic_pointer_cast<GenericTrack>(track);
    if (!generic) return TrackAndMedia();
    return attempt(track, media, [&] { generic->addMedia(media, start); });
}

CommandHandler::TrackAndMedia ProjectIndependentCommandHandler::removeMedia(const TrackPtr& track,
                                                                            const MediaPtr& media) {
    // Only a track that takes clips gives one up: a part taken off a stitched
    // media's track could not be put back by the undo.
    if (!boost::dynamic_pointer_cast<GenericTrack>(track)) return TrackAndMedia();
    return attempt(track, media, [&] { track->removeMedia(media); });
}

} // namespace VelaMediaLib
