#include <VelaMediaLib/document/format/XMLOptions.h>

namespace VelaMediaLib {

XMLOptions::XMLOptions(std::ostream& stream, int indentWidth) : stream_(stream), indentWidth_(indentWidth) {}

std::string XMLOptions::indentation(int level) const {
    return std::string(size_t(level > 0 ? level * indentWidth_ : 0), ' ');
}

unsigned XMLOptions::assignNewIdent(const void* object) {
    const unsigned ident = nextIdent_++;
    idents_[object] = ident;
    return ident;
}

unsigned XMLOptions::findIdent(const void* object) const {
    const auto found = idents_.find(object);
    return found == idents_.end() ? 0 : found->second;
}

std::string XMLOptions::modifyPath(const std::string& path) const {
    return pathModifier_ ? pathModifier_(path) : path;
}

} // namespace VelaMediaLib
