#include <VelaMediaLib/document/format/XMLOptions.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {

XMLOptions::XMLOptions(std::ostream& stream, int indentWidth) : stream_(stream), indentWidth_(indentWidth) {}

std::string XMLOptions::indentation(int level) const {
    return std::string(size_t(level > 0 && !compact() ? level * indentWidth_ : 0), ' ');
}

void XMLOptions::separate(bool array) {
    if (open_.empty()) return;
    Container& innermost = open_.back();
    if (innermost.array != array)
        throw VelaMediaLibException(array ? "an array element written inside an object"
                                          : "an object member written inside an array");
    if (!innermost.empty) stream_ << (compact() ? "," : ",\n");
    innermost.empty = false;
    stream_ << indentation(innermost.level + 1);
}

std::string XMLOptions::inlineKey(const std::string& name) const {
    return compact() ? quotedJSONString(name) + ":" : keyName(name);
}

std::ostream& XMLOptions::key(const std::string& name) {
    separate(false);
    return stream_ << inlineKey(name);
}

std::ostream& XMLOptions::element() {
    separate(true);
    return stream_;
}

void XMLOptions::openContainer(int level, bool array) {
    stream_ << (array ? "[" : "{");
    if (!compact()) stream_ << "\n";
    open_.push_back(Container{level, array, true});
}

void XMLOptions::closeContainer() {
    if (open_.empty()) return;
    const Container closing = open_.back();
    open_.pop_back();
    if (!closing.empty && !compact()) stream_ << "\n";
    stream_ << indentation(closing.level) << (closing.array ? "]" : "}");
}

unsigned XMLOptions::assignNewIdent(const void* object) {
    const auto inserted = idents_.emplace(object, nextIdent_);
    if (inserted.second) ++nextIdent_;
    return inserted.first->second;
}

unsigned XMLOptions::findIdent(const void* object) const {
    const auto found = idents_.find(object);
    return found == idents_.end() ? 0 : found->second;
}

std::string XMLOptions::modifyPath(const std::string& path) const {
    return pathModifier_ ? pathModifier_(path) : path;
}

} // namespace VelaMediaLib
