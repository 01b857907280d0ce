#pragma once

#include "Subcommand.h"

namespace VelaTool {

/// `vela at DOC TICK`: the clips active at a tick, track by track, with their media time there.
class AtCommand : public Subcommand {
public:
    AtCommand();
    int run(const Arguments& arguments, Console& console) const override;
};

} // namespace VelaTool
