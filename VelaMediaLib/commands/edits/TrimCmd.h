#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

namespace VelaMediaLib {

/// Moves a clip's start edge by a tick delta (positive shortens it), the
/// content under the rest staying in place. Undo gives back the exact state.
class VELAMEDIALIB_API TrimStartCmd : public AtomicEditCmd {
public:
    static boost::shared_ptr<TrimStartCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                  VelaTime delta);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override { return restoreSavedState(handler); }

private:
    TrimStartCmd(const TrackPtr& track, const MediaPtr& media, VelaTime delta)
        : AtomicEditCmd(track, media, delta) {}
};

/// Moves a clip's end edge in by a tick delta (positive shortens it, negative
/// plays more media). Undo gives back the exact state.
class VELAMEDIALIB_API TrimEndCmd : public AtomicEditCmd {
public:
    static boost::shared_ptr<TrimEndCmd> create(const TrackPtr& track, const MediaPtr& media, VelaTime delta);
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override { return restoreSavedState(handler); }

private:
    TrimEndCmd(const TrackPtr& track, const MediaPtr& media, VelaTime delta)
        : AtomicEditCmd(track, media, delta) {}
};

} // namespace VelaMediaLib
