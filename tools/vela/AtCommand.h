#pragma once

#include "Subcommand.h"

namespace VelaTool {

/// `vela at DOC TICK`: the clips active at a tick, track by track, with their media time there.
class AtCommand : public Subcommand {
public:
    const char* name() const override;
    const char* summary() const override;
    std::string usage() const override;
    ArgumentSpec spec() const override;
    int run(const Arguments& arguments, Console& console) const override;
};

} // namespace VelaTool
