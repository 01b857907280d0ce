#pragma once

#include "Subcommand.h"

namespace VelaTool {

/// `vela roundtrip DOC`: reads, writes in the same form, and compares; exit 1 on a difference.
class RoundtripCommand : public Subcommand {
public:
    RoundtripCommand();
    int run(const Arguments& arguments, Console& console) const override;
};

} // namespace VelaTool
