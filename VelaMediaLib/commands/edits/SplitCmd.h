#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

#include <vector>

namespace VelaMediaLib {

/// Cuts the clip covering a tick of a track in two. The clip keeps the part
/// before the tick (a TrimEndCmd, its edge-following effects with it); a copy
/// whose content begins at the tick's offset into the clip takes the rest
/// (an AddMediaCmd). The copy plays on exactly where the clip stopped: its
/// media start is advanced by the offset in media time, its keyframes and
/// animations are shifted back by the offset (so every parameter has the
/// value it had there), and its effects are cut to what lies after the tick.
/// Edge modifications stay at the edges they belong to: the left part keeps
/// those of the start, the right part those of the end.
/// A transition on the clip's right edge moves to the copy's, shortened to
/// the copy where it is longer (it is taken off before the trim, since a clip
/// may not be shorter than its transitions). Refused (false, nothing changed) where no
/// clip covers the tick or the tick is a clip's first; a sub-edit's refusal
/// refuses the whole split.
class VELAMEDIALIB_API SplitCmd : public MultiCommand {
public:
    static boost::shared_ptr<SplitCmd> create(const TrackPtr& track, VelaTime time);
    /// The clips the last execution made (the right-hand copy).
    const std::vector<MediaPtr>& getCreatedMedias() const { return created_; }
    /// The clip covering the tick with the tick inside it (not at its start), or null.
    static MediaPtr mediaToSplit(const Track& track, VelaTime time);
    /// A copy of the clip standing at `offset` ticks into it, as the split
    /// makes it: off any track, without transitions.
    static MediaPtr rightHandCopy(const Media& media, VelaTime offset);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    SplitCmd(const TrackPtr& track, VelaTime time) : track_(track), time_(time) {}
    TrackPtr track_;
    VelaTime time_;
    std::vector<MediaPtr> created_;
};

} // namespace VelaMediaLib
