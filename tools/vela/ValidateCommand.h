#pragma once

#include "Subcommand.h"

namespace VelaTool {

/// `vela validate DOC`: exit 0 when the library reads the document, else its message and exit 1.
class ValidateCommand : public Subcommand {
public:
    ValidateCommand();
    int run(const Arguments& arguments, Console& console) const override;
};

} // namespace VelaTool
