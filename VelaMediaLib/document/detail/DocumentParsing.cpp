#include <VelaMediaLib/document/detail/DocumentParsing.h>

#include <json/reader.h>

#include <memory>
#include <string>

namespace VelaMediaLib {

namespace {

// Deep enough for any document the library writes, shallow enough that
// jsoncpp's own recursion stays far from the thread's stack end.
constexpr int kStackLimit = 400;

std::string versionText(const Json::Value& version) {
    if (version.isString()) return version.asString();
    if (version.isIntegral()) return compactJSON(version);
    if (version.isDouble()) return formatDouble(version.asDouble());
    refuseJSONValue("a version string", version);
}

// The rest of the stream, read in blocks (a character at a time costs as
// much as a fifth of the parse); sized at once when the stream can tell.
std::string wholeText(std::istream& in) {
    std::string text;
    const std::istream::pos_type at = in.tellg();
    if (at != std::istream::pos_type(-1) && in.seekg(0, std::ios::end)) {
        const std::istream::pos_type end = in.tellg();
        in.seekg(at);
        if (end > at) text.reserve(size_t(end - at));
    }
    in.clear();
    char block[1 << 16];
    while (in.read(block, sizeof block) || in.gcount() > 0) text.append(block, size_t(in.gcount()));
    return text;
}

} // namespace

Json::Value parseDocument(std::istream& in) {
    Json::Value root;
    {
        const std::string text = wholeText(in);
        Json::CharReaderBuilder builder;
        builder["collectComments"] = false;
        builder["allowComments"] = false;
        builder["failIfExtra"] = true;
        builder["rejectDupKeys"] = true;
        builder["allowSpecialFloats"] = false;
        builder["stackLimit"] = kStackLimit;
        const std::unique_ptr<Json::CharReader> reader(builder.newCharReader());
        std::string errors;
        bool parsed = false;
        try {
            parsed = reader->parse(text.data(), text.data() + text.size(), &root, &errors);
        } catch (const Json::Exception&) {
            parsed = false; // too deep, or a number jsoncpp cannot hold
        }
        if (!parsed) throw ParserException("Invalid project json");
    }
    if (!root.isObject()) refuseDocument("expected a document object");
    return root;
}

VersionInfo documentVersionInfo(const Json::Value& root) {
    VersionInfo info;
    const Json::Value* version = optionalMember(root, "version");
    info.version = version ? versionText(*version) : "6.0";
    if (const Json::Value* client = optionalMember(root, "authoringClientName")) {
        documentObject(*client, "an authoringClientName object");
        if (const Json::Value* name = optionalMember(*client, "name"))
            info.clientName = jsonValueAsString(*name);
        if (const Json::Value* clientVersion = optionalMember(*client, "version"))
            info.clientVersion = jsonValueAsString(*clientVersion);
        if (const Json::Value* platform = optionalMember(*client, "platform"))
            info.platform = jsonValueAsString(*platform);
    }
    return info;
}

} // namespace VelaMediaLib
