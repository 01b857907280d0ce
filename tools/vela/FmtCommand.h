#pragma once

#include "Subcommand.h"

namespace VelaTool {

/// `vela fmt DOC [-o OUT] [--compact]`: the document rewritten in the library's form.
class FmtCommand : public Subcommand {
public:
    FmtCommand();
    int run(const Arguments& arguments, Console& console) const override;
};

} // namespace VelaTool
