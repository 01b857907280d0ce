#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

namespace VelaMediaLib {

/// Moves one edge of a clip by a tick delta while it keeps playing the same
/// slice of media: the scalar changes so that the slice fills the new length
/// exactly, and the other edge stays where it is. A positive delta shortens
/// the clip (it plays faster). Refused (false) for a clip on no track, one
/// the delta would leave without a tick or shorter than its transitions
/// allow, a collision, or a clip whose limits do not take the new state.
/// Undo and redo give back the exact states.
class VELAMEDIALIB_API StretchTrimCmd : public AtomicEditCmd {
public:
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override { return restoreSavedState(handler); }
    bool reexecute(CommandHandler* handler) override { return restoreAfter(handler); }

protected:
    StretchTrimCmd(const MediaPtr& media, VelaTime delta, bool startEdge)
        : AtomicEditCmd(TrackPtr(), media, delta), startEdge_(startEdge) {}

private:
    bool startEdge_;
};

/// Stretches a clip by moving its start edge; its end stays.
class VELAMEDIALIB_API StretchTrimStartCmd : public StretchTrimCmd {
public:
    static boost::shared_ptr<StretchTrimStartCmd> create(const MediaPtr& media, VelaTime delta);

private:
    StretchTrimStartCmd(const MediaPtr& media, VelaTime delta) : StretchTrimCmd(media, delta, true) {}
};

/// Stretches a clip by moving its end edge in by the delta; its start stays.
class VELAMEDIALIB_API StretchTrimEndCmd : public StretchTrimCmd {
public:
    static boost::shared_ptr<StretchTrimEndCmd> create(const MediaPtr& media, VelaTime delta);

private:
    StretchTrimEndCmd(const MediaPtr& media, VelaTime delta) : StretchTrimCmd(media, delta, false) {}
};

} // namespace VelaMediaLib
