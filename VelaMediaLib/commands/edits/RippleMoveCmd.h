#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

/// Moves a clip and every clip after it on its track by the same tick delta,
/// one MoveCmd each. The clips are taken in start order and moved earliest
/// first for a move to the left (a delta below one tick), latest first
/// otherwise, so that no clip lands on one that has not moved yet. Refused
/// (false, nothing changed) for a clip not on the track, a zero delta, or a
/// move that collides (a move left into an earlier clip).
class VELAMEDIALIB_API RippleMoveCmd : public MultiCommand {
public:
    static boost::shared_ptr<RippleMoveCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                   VelaTime delta);
    bool execute(CommandHandler* handler) override;
    using MultiCommand::execute;

protected:
    void executeCommands(const CommandHandler* handler) override;

private:
    RippleMoveCmd(const TrackPtr& track, const MediaPtr& media, VelaTime delta)
        : track_(track), media_(media), delta_(delta) {}
    TrackPtr track_;
    MediaPtr media_;
    VelaTime delta_;
};

} // namespace VelaMediaLib
