#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>

namespace VelaMediaLib {

/// Anything that executes commands: the project's history, or a composite
/// recording its sub-commands. Edit code is written against an executor so
/// that it works at the top level and inside a composite alike.
class VELAMEDIALIB_API CommandExecutor {
public:
    virtual ~CommandExecutor() = default;
    virtual bool execute(const CommandPtr& command) = 0;
    /// Queues an edit that answers a change (a magnetic track closing its
    /// gaps, a behavior, a script). Observers never edit from inside their
    /// update: they queue here, and the history runs each queued edit after
    /// the command being executed has finished and released its locks, as an
    /// undo step of its own. A composite passes it on to the history running
    /// it. Observers hear on whichever thread edits, so this is safe from any.
    virtual void queueFollowUp(const CommandPtr& command) = 0;
    /// Whether the executor is undoing or redoing on the calling thread: what
    /// changes then is a replay of recorded edits, which observers must not
    /// answer with new ones.
    virtual bool isReplaying() const { return false; }
};

} // namespace VelaMediaLib
