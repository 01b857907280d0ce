#pragma once

#include "Subcommand.h"

namespace VelaTool {

/// `vela info DOC [--json]`: what the project holds, as text or one JSON object.
class InfoCommand : public Subcommand {
public:
    InfoCommand();
    int run(const Arguments& arguments, Console& console) const override;
};

} // namespace VelaTool
