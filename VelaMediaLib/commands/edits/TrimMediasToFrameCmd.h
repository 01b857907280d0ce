#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Mixer.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

/// Trims clips so that they end at a tick (the frame a user stands on): each
/// clip's end edge moves back to the tick with a TrimEndCmd, its magnetized
/// effects following, its start and content staying where they are.
/// For one clip: the tick must lie inside it, after its start and not past its
/// end (else VelaMediaLibException "the time is outside the clip"); a clip
/// already ending there leaves nothing to do (false). A clip on no track
/// throws "the clip is on no track".
/// For a mixer: every clip of its tracks running across the tick is trimmed;
/// clips starting at or after it are left as they are; with none across it
/// there is nothing to do (false).
/// A trim that the model refuses (a clip shorter than its transitions)
/// refuses the whole, rolled back.
class VELAMEDIALIB_API TrimMediasToFrameCmd : public MultiCommand {
public:
    static boost::shared_ptr<TrimMediasToFrameCmd> create(const MediaPtr& media, VelaTime time);
    static boost::shared_ptr<TrimMediasToFrameCmd> create(const MixerPtr& mixer, VelaTime time);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    TrimMediasToFrameCmd(const MediaPtr& media, const MixerPtr& mixer, VelaTime time)
        : media_(media), mixer_(mixer), time_(time) {}
    /// Trims the clip of the track to end at the time; false when refused.
    bool trimToTime(const TrackPtr& track, const MediaPtr& media);

    MediaPtr media_;
    MixerPtr mixer_;
    VelaTime time_;
};

} // namespace VelaMediaLib
