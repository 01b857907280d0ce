#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

class FileSystem;

/// Reads a whole project document: "editRate" (30/1 when absent) makes the
/// project, then come the project attributes, "width" and "height",
/// "authoringClientName", "sourceBin", "timeline" and "metadata", and last
/// the hotspots' marker targets. The project is built here and given out
/// (project()) only once the whole read succeeded; while it is read its
/// parsingProject() is true.
class VELAMEDIALIB_API ProjectReader : public JSONReader {
public:
    explicit ProjectReader(const boost::shared_ptr<ReadContext>& context = {},
                           const boost::shared_ptr<FileSystem>& fileSystem = {});
    bool read(const Json::Value& root) override;
    const boost::shared_ptr<Project>& project() const { return project_; }

    /// The edit rate of the root, reduced: "editRate", or 30/1 without one.
    /// Throws boost::bad_rational for a zero denominator.
    static boost::rational<unsigned long> readEditRate(const Json::Value& root);
    /// The project attributes, "width" and "height", and "authoringClientName".
    static void readProjectAttributes(const Json::Value& root, Project& project);

private:
    boost::shared_ptr<FileSystem> fileSystem_;
    boost::shared_ptr<Project> project_;
};

} // namespace VelaMediaLib
