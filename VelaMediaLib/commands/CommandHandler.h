#pragma once

#include <VelaMediaLib/model/Track.h>

#include <utility>

namespace VelaMediaLib {

/// What commands reach the model through. Each operation takes the track and
/// the clip and answers the track and clip after the edit (an edit may
/// replace the clip), or an empty pair when the model refused it.
class CommandHandler {
public:
    typedef std::pair<TrackPtr, MediaPtr> TrackAndMedia;

    virtual ~CommandHandler() = default;
    virtual TrackAndMedia moveMedia(const TrackPtr& track, const MediaPtr& media, VelaTime delta) = 0;
    virtual TrackAndMedia trimMediaStart(const TrackPtr& track, const MediaPtr& media, VelaTime delta) = 0;
    virtual TrackAndMedia trimMediaEnd(const TrackPtr& track, const MediaPtr& media, VelaTime delta) = 0;
    virtual TrackAndMedia addMedia(const TrackPtr& track, const MediaPtr& media, VelaTime start) = 0;
    virtual TrackAndMedia removeMedia(const TrackPtr& track, const MediaPtr& media) = 0;
};

/// The handler for commands that need nothing of a project but its tracks:
/// it carries the edits out on the tracks and answers a refused one (a
/// collision or a trim past the limits) with an empty pair.
class ProjectIndependentCommandHandler : public CommandHandler {
public:
    TrackAndMedia moveMedia(const TrackPtr& track, const MediaPtr& media, VelaTime delta) override;
    TrackAndMedia trimMediaStart(const TrackPtr& track, const MediaPtr& media, VelaTime delta) override;
    TrackAndMedia trimMediaEnd(const TrackPtr& track, const MediaPtr& media, VelaTime delta) override;
    TrackAndMedia addMedia(const TrackPtr& track, const MediaPtr& media, VelaTime start) override;
    TrackAndMedia removeMedia(const TrackPtr& track, const MediaPtr& media) override;
};

} // namespace VelaMediaLib
