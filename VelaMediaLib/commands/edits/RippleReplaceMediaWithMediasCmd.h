#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/ReplaceMediaWithMediasCmd.h>

namespace VelaMediaLib {

/// Replaces a clip with a list of clips as ReplaceMediaWithMediasCmd does,
/// and moves everything after the replaced clip on its track by the
/// difference in length (the list's total less the clip's duration), with a
/// RippleMoveCmd issued once the clip is off: a longer list pushes the rest
/// later, a shorter one pulls it earlier, and the gap after the clip keeps
/// its length. All or nothing, with the refusals of the replacement.
class VELAMEDIALIB_API RippleReplaceMediaWithMediasCmd : public ReplaceMediaWithMediasCmd {
public:
    /// Throws as ReplaceMediaWithMediasCmd::create.
    static boost::shared_ptr<RippleReplaceMediaWithMediasCmd>
    create(const TrackPtr& track, const MediaPtr& media, const std::vector<MediaPtr>& medias);

protected:
    bool makeRoom(VelaTime oldEnd, VelaTime change) override;

private:
    RippleReplaceMediaWithMediasCmd(const TrackPtr& track, const MediaPtr& media,
                                    const std::vector<MediaPtr>& medias)
        : ReplaceMediaWithMediasCmd(track, media, medias) {}
};

} // namespace VelaMediaLib
