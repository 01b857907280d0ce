#include <VelaMediaLib/document/ChangedFileHandler.h>
#include <VelaMediaLib/document/MissingFileHandler.h>
#include <VelaMediaLib/document/ProjectReader.h>
#include <VelaMediaLib/document/RemixParser.h>
#include <VelaMediaLib/document/detail/DocumentParsing.h>

#include <boost/make_shared.hpp>
#include <fstream>
#include <vector>

namespace VelaMediaLib {

namespace {

/// The dotted parts as numbers; false when a part is not a plain number.
bool dottedNumbers(const std::string& text, std::vector<unsigned long long>& parts) {
    if (text.empty()) return false;
    size_t from = 0;
    while (true) {
        const size_t dot = text.find('.', from);
        const std::string part = text.substr(from, dot == std::string::npos ? std::string::npos : dot - from);
        if (part.empty() || part.size() > 18 || part.find_first_not_of("0123456789") != std::string::npos)
            return false;
        parts.push_back(std::stoull(part));
        if (dot == std::string::npos) return true;
        from = dot + 1;
    }
}

} // namespace

RemixParser::RemixParser(const boost::shared_ptr<MissingFileHandler>& missing,
                         const boost::shared_ptr<ChangedFileHandler>& changed)
    : missing_(missing), changed_(changed) {
    versionInfo_.version = "6.0";
}

RemixParser::~RemixParser() = default;

bool RemixParser::versionPasses(const std::string& requirement, const std::string& version) {
    if (requirement.compare(0, 2, ">=") != 0) return requirement == version;
    std::vector<unsigned long long> minimum, given;
    if (!dottedNumbers(requirement.substr(2), minimum) || !dottedNumbers(version, given)) return false;
    const size_t parts = std::max(minimum.size(), given.size());
    minimum.resize(parts, 0);
    given.resize(parts, 0);
    return given >= minimum; // part by part, the first that differs decides
}

bool RemixParser::parse(std::istream& in) {
    Json::Value root = parseDocument(in);
    const VersionInfo info = parsingDocument([&] { return documentVersionInfo(root); });
    if (!versionPasses(versionRequirement(), info.version))
        throw ParserVersionException("Unsupported project version : " + info.version);
    const auto context = boost::make_shared<ReadContext>();
    context->missingFileHandler = missing_;
    context->changedFileHandler = changed_;
    context->releaseTracks = true; // the tree is this parse's own
    context->checkFiles = checkFiles_;
    ProjectReader reader(context, fileSystem_);
    parsingDocument([&] { return reader.read(root); });
    project_ = reader.project();
    versionInfo_ = info;
    return true;
}

bool RemixParser::parse(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    if (!in) return false;
    return parse(in);
}

VersionInfo RemixParser::parseVersionInfo(std::istream& in) {
    const Json::Value root = parseDocument(in);
    return parsingDocument([&] { return documentVersionInfo(root); });
}

VersionInfo RemixParser::parseVersionInfo(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    if (!in) throw IOException("cannot open file: " + path);
    return parseVersionInfo(in);
}

} // namespace VelaMediaLib
