#include <VelaMediaLib/document/ProjectAssetParser.h>
#include <VelaMediaLib/document/ProjectReader.h>
#include <VelaMediaLib/document/detail/DocumentParsing.h>

#include <boost/make_shared.hpp>

namespace VelaMediaLib {

VersionInfo ProjectAssetParser::versionInfo() const {
    VersionInfo info;
    info.version = "6.0";
    info.clientName = clientName_;
    return info;
}

bool ProjectAssetParser::parse(std::istream& in) {
    Json::Value root = parseDocument(in);
    std::string ident, client;
    VelaTime duration = 0;
    const auto context = boost::make_shared<ReadContext>();
    context->releaseTracks = true;
    ProjectReader reader(context);
    parsingDocument([&] {
        if (const Json::Value* name = optionalMember(root, "ident")) ident = jsonValueAsString(*name);
        if (const Json::Value* name = optionalMember(root, "clientName")) client = jsonValueAsString(*name);
        if (const Json::Value* length = optionalMember(root, "duration"))
            duration = jsonValueAsVelaTime(*length);
        if (duration < 0) refuseDocument("negative duration: " + std::to_string(duration));
        root.removeMember("authoringClientName"); // an asset names its client by "clientName"
        return reader.read(root);
    });
    project_ = reader.project();
    ident_ = ident;
    clientName_ = client;
    duration_ = duration;
    return true;
}

} // namespace VelaMediaLib
