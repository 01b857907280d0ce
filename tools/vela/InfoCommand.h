#pragma once

#include "Subcommand.h"

namespace VelaTool {

/// `vela info DOC [--json]`: what the project holds, as text or one JSON object.
class InfoCommand : public Subcommand {
public:
    const char* name() const override;
    const char* summary() const override;
    std::string usage() const override;
    ArgumentSpec spec() const override;
    int run(const Arguments& arguments, Console& console) const override;
};

} // namespace VelaTool
