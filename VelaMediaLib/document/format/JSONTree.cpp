#include <VelaMediaLib/document/format/JSONTree.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/detail/JSONTreeAccess.h>

#include <sstream>

namespace VelaMediaLib {
namespace {

void writeValue(XMLOptions& options, int indent, const Json::Value& value);

void writeContainer(XMLOptions& options, int indent, const Json::Value& value) {
    const bool array = value.isArray();
    JSONWriter container(options, indent, array ? JSONWriter::Array : JSONWriter::Object);
    for (auto member = value.begin(); member != value.end(); ++member) {
        if (array)
            options.element();
        else
            options.key(member.name());
        writeValue(options, container.memberLevel(), *member);
    }
}

void writeValue(XMLOptions& options, int indent, const Json::Value& value) {
    switch (value.type()) {
    case Json::nullValue:
        options.stream() << "null";
        break;
    case Json::intValue:
        options.stream() << value.asLargestInt();
        break;
    case Json::uintValue:
        options.stream() << value.asLargestUInt();
        break;
    case Json::realValue:
        writeJSONValue(options, indent, value.asDouble());
        break;
    case Json::stringValue:
        writeJSONValue(options, indent, value.asString());
        break;
    case Json::booleanValue:
        writeJSONValue(options, indent, value.asBool());
        break;
    case Json::arrayValue:
    case Json::objectValue:
        writeContainer(options, indent, value);
        break;
    }
}

} // namespace

JSONTree::JSONTree() = default;

bool JSONTree::isNull() const { return !value_; }

bool JSONTree::isEmpty() const {
    return !value_ || ((value_->isObject() || value_->isArray()) && value_->empty());
}

void JSONTree::write(XMLOptions& options, int indent) const {
    writeValue(options, indent, jsonTreeValue(*this));
}

std::string JSONTree::toCompactString() const {
    std::ostringstream text;
    XMLOptions compact(text, 0);
    write(compact, 0);
    return text.str();
}

bool JSONTree::operator==(const JSONTree& other) const {
    return value_ == other.value_ || jsonTreeValue(*this) == jsonTreeValue(other);
}

} // namespace VelaMediaLib
