#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <utility>

namespace VelaMediaLib {

class Project;

/// What commands reach the model through. Each operation takes the track and
/// the clip and answers the track and clip after the edit (an edit may
/// replace the clip), or an empty pair when the model refused it.
class VELAMEDIALIB_API CommandHandler {
public:
    typedef std::pair<TrackPtr, MediaPtr> TrackAndMedia;

    virtual ~CommandHandler() = default;
    virtual TrackAndMedia moveMedia(const TrackPtr& track, const MediaPtr& media, VelaTime delta) = 0;
    virtual TrackAndMedia trimMediaStart(const TrackPtr& track, const MediaPtr& media, VelaTime delta) = 0;
    virtual TrackAndMedia trimMediaEnd(const TrackPtr& track, const MediaPtr& media, VelaTime delta) = 0;
    /// Multiplies the clip's scalar by the factor; refused where the clip
    /// would be left shorter than its transitions allow, as a trim is.
    virtual TrackAndMedia stretchMedia(const TrackPtr& track, const MediaPtr& media,
                                       const SafeRational& factor) = 0;
    /// Gives the clip a state it had before, exactly (no tolerance).
    virtual TrackAndMedia restoreMediaState(const TrackPtr& track, const MediaPtr& media,
                                            const MediaState& state) = 0;
    virtual TrackAndMedia addMedia(const TrackPtr& track, const MediaPtr& media, VelaTime start) = 0;
    virtual TrackAndMedia removeMedia(const TrackPtr& track, const MediaPtr& media) = 0;
    /// The project the commands act on, for those that need more than its
    /// tracks (loading a source); null for a handler of no project. A handler
    /// that stands in front of a project's passes it on.
    virtual boost::shared_ptr<Project> project() { return boost::shared_ptr<Project>(); }
};

/// The handler for commands that need nothing of a project but its tracks:
/// it carries the edits out on the tracks and answers a refused one (a
/// collision, a trim past the limits, a stretch to nothing or below the
/// transitions' room, a state the clip does not accept, a clip not on the
/// track) with an empty pair.
class VELAMEDIALIB_API ProjectIndependentCommandHandler : public CommandHandler {
public:
    TrackAndMedia moveMedia(const TrackPtr& track, const MediaPtr& media, VelaTime delta) override;
    TrackAndMedia trimMediaStart(const TrackPtr& track, const MediaPtr& media, VelaTime delta) override;
    TrackAndMedia trimMediaEnd(const TrackPtr& track, const MediaPtr& media, VelaTime delta) override;
    TrackAndMedia stretchMedia(const TrackPtr& track, const MediaPtr& media,
                               const SafeRational& factor) override;
    TrackAndMedia restoreMediaState(const TrackPtr& track, const MediaPtr& media,
                                    const MediaState& state) override;
    TrackAndMedia addMedia(const TrackPtr& track, const MediaPtr& media, VelaTime start) override;
    TrackAndMedia removeMedia(const TrackPtr& track, const MediaPtr& media) override;
};

} // namespace VelaMediaLib
