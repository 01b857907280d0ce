#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/ParserInterface.h>

#include <boost/shared_ptr.hpp>
#include <istream>
#include <string>

namespace VelaMediaLib {

class ChangedFileHandler;
class FileSystem;
class MissingFileHandler;
class Project;

/// The project document parser. A parse reads the whole text (jsoncpp),
/// checks the version against ">=0.5", builds a new project through
/// ProjectReader and keeps it only when every step succeeded: a failed
/// parse throws ParserException (never anything else but std::bad_alloc)
/// and leaves project() as it was. Messages: "Invalid project json" for
/// text that is not JSON; "Unsupported project version : <version>";
/// "Load cancelled: <path>" when a file handler says no; otherwise
/// "Invalid project json - " and what was wrong.
class VELAMEDIALIB_API RemixParser : public ParserInterface {
public:
    explicit RemixParser(const boost::shared_ptr<MissingFileHandler>& missing = {},
                         const boost::shared_ptr<ChangedFileHandler>& changed = {});
    ~RemixParser() override;

    bool parse(std::istream& in);
    /// False when the file cannot be opened.
    bool parse(const std::string& path);
    /// The project of the last successful parse, or null.
    boost::shared_ptr<Project> project() const { return project_; }
    /// The version information of the last document parsed ("6.0" before any).
    VersionInfo versionInfo() const override { return versionInfo_; }

    /// The document's version information alone ("version", or "6.0" when it
    /// has none; "name", "version", "platform" of "authoringClientName").
    /// Throws ParserException "Invalid project json" for text that is not JSON.
    static VersionInfo parseVersionInfo(std::istream& in);
    /// The same from a file; throws IOException when it cannot be opened.
    static VersionInfo parseVersionInfo(const std::string& path);

    static const char* versionRequirement() { return ">=0.5"; }
    /// Whether the version meets the requirement: ">=" and a minimum compared
    /// as dotted numbers part by part (missing parts count 0), or else equal.
    static bool versionPasses(const std::string& requirement, const std::string& version);

    /// The file system sources ask about their files (the host's by default).
    void setFileSystem(const boost::shared_ptr<FileSystem>& fileSystem) { fileSystem_ = fileSystem; }
    /// Whether files are looked at while loading (true); a copy of a project
    /// already loaded need not.
    void setCheckFiles(bool check) { checkFiles_ = check; }

private:
    boost::shared_ptr<MissingFileHandler> missing_;
    boost::shared_ptr<ChangedFileHandler> changed_;
    boost::shared_ptr<FileSystem> fileSystem_;
    boost::shared_ptr<Project> project_;
    VersionInfo versionInfo_;
    bool checkFiles_ = true;
};

} // namespace VelaMediaLib
