#include <VelaMediaLib/document/detail/DocumentParsing.h>

#include <json/reader.h>

#include <iterator>
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

} // namespace

Json::Value parseDocument(std::istream& in) {
    Json::Value root;
    {
        const std::string text((std::istreambuf_iterator<char>(in)), std::istreambuf_iterator<char>());
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
