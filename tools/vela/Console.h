#pragma once

#include <iosfwd>

namespace VelaTool {

/// The streams a subcommand talks through: the program's own, or a test's.
struct Console {
    std::istream& in;
    std::ostream& out;
    std::ostream& err;
};

} // namespace VelaTool
