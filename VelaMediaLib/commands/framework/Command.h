#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>

#include <boost/enable_shared_from_this.hpp>
#include <boost/shared_ptr.hpp>
#include <string>

namespace VelaMediaLib {

class CommandHandler;
class Command;
typedef boost::shared_ptr<Command> CommandPtr;

/// An undoable edit. Commands are owned through shared pointers; executing
/// one returns whether it took effect, and only those that did are recorded.
class VELAMEDIALIB_API Command : public VelaObject, public boost::enable_shared_from_this<Command> {
public:
    virtual bool execute(CommandHandler* handler) = 0;
    virtual bool unexecute(CommandHandler* handler) = 0;
    /// Redo; by default the edit is carried out again.
    virtual bool reexecute(CommandHandler* handler) { return execute(handler); }
    /// This command followed by a later one, as one undo step. Throws
    /// boost::bad_weak_ptr for a command not owned by a shared pointer.
    virtual CommandPtr combine(const CommandPtr& later);
    virtual std::string name() const { return name_; }
    void setName(const std::string& name) { name_ = name; }

    /// The two commands grouped into one.
    static CommandPtr groupCommands(const CommandPtr& first, const CommandPtr& second);

private:
    std::string name_;
};

} // namespace VelaMediaLib
