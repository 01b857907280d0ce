#pragma once

#include <stdexcept>
#include <string>

namespace VelaTool {

/// A command line the tool cannot follow: reported with the usage, exit 2.
class UsageError : public std::runtime_error {
public:
    explicit UsageError(const std::string& what) : std::runtime_error(what) {}
};

} // namespace VelaTool
