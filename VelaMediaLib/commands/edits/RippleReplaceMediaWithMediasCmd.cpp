#include <VelaMediaLib/commands/edits/RippleReplaceMediaWithMediasCmd.h>

#include <VelaMediaLib/commands/edits/RippleMoveCmd.h>

namespace VelaMediaLib {

boost::shared_ptr<RippleReplaceMediaWithMediasCmd>
RippleReplaceMediaWithMediasCmd::create(const TrackPtr& track, const MediaPtr& media,
                                        const std::vector<MediaPtr>& medias) {
    check(track, media, medias);
    const boost::shared_ptr<RippleReplaceMediaWithMediasCmd> command(
        new RippleReplaceMediaWithMediasCmd(track, media, medias));
    command->setName("Ripple Replace Media");
    return command;
}

// The clip is off first: a shorter list pulls the next clip back into the
// room the clip left (never past its start), so the ripple cannot collide.
bool RippleReplaceMediaWithMediasCmd::makeRoom(VelaTime oldEnd, VelaTime change) {
    if (change == 0) return true;
    MediaPtr next;
    {
        ScopedReadLock lock(track_->projectLock());
        const auto at = track_->lower_bound(oldEnd);
        if (at != track_->mediaEnd()) next = at->second;
    }
    return !next || executeRequired(RippleMoveCmd::create(track_, next, change));
}

} // namespace VelaMediaLib
