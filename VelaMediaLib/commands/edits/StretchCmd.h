#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>

namespace VelaMediaLib {

/// Gives a clip a new scalar on the track it stands on: the same media range
/// plays faster or slower, the duration following. Undo gives back the exact
/// state; a clip on no track, or one the stretch would leave without a tick
/// or shorter than its transitions allow, refuses (false). Redo gives back
/// the exact state the stretch gave. Two stretches of the same clip in a row
/// combine into one undo step: undone to the first one's state, redone to
/// the second one's, with its scalar.
class VELAMEDIALIB_API StretchCmd : public AtomicEditCmd {
public:
    /// Throws ValueException<double> "a clip's scalar must be above zero".
    static boost::shared_ptr<StretchCmd> create(const MediaPtr& media, const SafeRational& scalar);
    static boost::shared_ptr<StretchCmd> create(const MediaPtr& media, double scalar);
    const SafeRational& scalar() const { return scalar_; }
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override { return restoreSavedState(handler); }
    bool reexecute(CommandHandler* handler) override { return restoreAfter(handler); }
    CommandPtr combine(const CommandPtr& later) override;

private:
    StretchCmd(const MediaPtr& media, const SafeRational& scalar)
        : AtomicEditCmd(TrackPtr(), media, 0), scalar_(scalar) {}
    SafeRational scalar_;
};

} // namespace VelaMediaLib
