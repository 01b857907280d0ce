#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

namespace VelaMediaLib {

class Observer;

/// Lock and visibility questions over tracks, clips and transitions. A clip
/// answers through its track's flags, a transition through its clips; a clip
/// or transition that is on no track is editable, shown and unlocked.
class VELAMEDIALIB_API LockData {
public:
    static bool IsTrackLocked(const Track& track) { return track.isLocked(); }
    static bool IsTrackHidden(const Track& track) { return track.attributeValue("videoHidden", false); }
    /// Not seen, whether hidden or left out by another track's solo.
    static bool IsTrackInvisible(const Track& track) { return !track.isVisible(); }
    static bool IsTrackEditable(const Track& track) { return !track.isLocked(); }

    static bool IsMediaLocked(const Media& media);
    static bool IsMediaHidden(const Media& media);
    static bool IsMediaInvisible(const Media& media);
    static bool IsMediaEditable(const Media& media) { return !IsMediaLocked(media); }

    static bool IsTransitionLocked(const Transition& transition);
    static bool IsTransitionHidden(const Transition& transition);
    static bool IsTransitionEditable(const Transition& transition) { return !IsTransitionLocked(transition); }

    static std::vector<TrackPtr> GetAllEditableTracks(const Timeline& timeline);
    static void SetIsLocked(Track& track, bool locked) { track.setIsLocked(locked); }
    /// Undoable commands that set a track's locked, hidden or solo flag.
    static boost::shared_ptr<Command> GetChangeIsLockedCommand(const TrackPtr& track, bool locked);
    static boost::shared_ptr<Command> GetChangeIsHiddenCommand(const TrackPtr& track, bool hidden);
    static boost::shared_ptr<Command> GetChangeIsSoloCommand(const TrackPtr& track, bool solo);
    /// Observes a track's locked flag (the observer hears each change of it).
    static void Attach(Track& track, Observer* observer);
    static void Detach(Track& track, Observer* observer);

private:
    static TrackPtr trackOf(const Media& media);
};

} // namespace VelaMediaLib
