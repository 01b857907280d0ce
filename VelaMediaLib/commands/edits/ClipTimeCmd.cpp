#include <VelaMediaLib/commands/edits/ClipTimeCmd.h>

#include <string>

namespace VelaMediaLib {

ClipTimeCmd::ClipTimeCmd(const MediaPtr& media, VelaTime time, VelaTime amount, bool extend, const char* what,
                         const char* kind)
    : media_(media), time_(time), amount_(amount), extend_(extend) {
    if (!media) throw VelaMediaLibException(std::string("no clip to ") + what);
    if (amount < 0)
        throw ValueException<long long>(std::string(kind) + " time amount must not be negative", amount);
}

} // namespace VelaMediaLib
