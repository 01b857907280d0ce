#include <VelaMediaLib/base/TextAttributeList.h>

namespace VelaMediaLib {

bool TextAttributeList::addRun(size_t start, size_t length, const std::string& name,
                               const std::string& value) {
    if (start > text_.size() || length > text_.size() - start) return false;
    runs_.push_back(Run{start, length, name, value});
    return true;
}

std::string TextAttributeList::attributeAt(size_t position, const std::string& name) const {
    std::string value;
    for (const Run& run : runs_)
        if (run.name == name && position >= run.start && position < run.start + run.length) value = run.value;
    return value;
}

std::ostream& operator<<(std::ostream& out, const TextAttributeList& list) {
    return out << "TextAttributeList(" << list.text() << ", " << list.runs().size() << " runs)";
}

} // namespace VelaMediaLib
