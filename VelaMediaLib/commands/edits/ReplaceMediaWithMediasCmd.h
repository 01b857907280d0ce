#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// Takes a clip off its track (RemoveMediaCmd) and places a list of clips
/// in its place, one after another from where it started (AddMediaCmd
/// each), each at its own duration. The clips placed must lie on no track.
/// All or nothing: a clip not on the track, a placed clip that collides
/// with another (a list longer than the gap the clip leaves, reaching into
/// the next clip) or one that already lies elsewhere refuses the whole
/// command (false, nothing changed).
class VELAMEDIALIB_API ReplaceMediaWithMediasCmd : public MultiCommand {
public:
    /// Throws VelaMediaLibException for no track or clip, an empty list, a
    /// null entry, the replaced clip among the list, or a clip listed twice.
    static boost::shared_ptr<ReplaceMediaWithMediasCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                               const std::vector<MediaPtr>& medias);
    const std::vector<MediaPtr>& medias() const { return medias_; }

protected:
    ReplaceMediaWithMediasCmd(const TrackPtr& track, const MediaPtr& media,
                              const std::vector<MediaPtr>& medias)
        : track_(track), media_(media), medias_(medias) {}
    /// Checks the arguments (the exceptions of create).
    static void check(const TrackPtr& track, const MediaPtr& media, const std::vector<MediaPtr>& medias);
    void executeCommands(const CommandHandler* handler) override;
    /// Between taking the clip off and placing the list: what follows the
    /// clip may move by the change of length. Nothing here.
    virtual bool makeRoom(VelaTime /*oldEnd*/, VelaTime /*change*/) { return true; }

    TrackPtr track_;
    MediaPtr media_;
    std::vector<MediaPtr> medias_;
};

} // namespace VelaMediaLib
