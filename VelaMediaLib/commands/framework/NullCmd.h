#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/Command.h>

namespace VelaMediaLib {

/// A command that does nothing and reports success.
class VELAMEDIALIB_API NullCmd : public Command {
public:
    static boost::shared_ptr<NullCmd> create() { return boost::shared_ptr<NullCmd>(new NullCmd); }
    bool execute(CommandHandler*) override { return true; }
    bool unexecute(CommandHandler*) override { return true; }

private:
    NullCmd() = default;
};

} // namespace VelaMediaLib
