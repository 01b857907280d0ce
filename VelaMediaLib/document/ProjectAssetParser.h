#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/ParserInterface.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <boost/shared_ptr.hpp>
#include <istream>
#include <string>

namespace VelaMediaLib {

class Project;

/// Reads an asset-library document (.assetproj): a root with "version",
/// "clientName" (a string), "editRate", "sourceBin", "timeline",
/// "duration" (ticks), "width", "height" and "ident" (the asset's name),
/// read into a new project as a project document is (no version test).
/// A failure throws ParserException and keeps nothing.
class VELAMEDIALIB_API ProjectAssetParser : public ParserInterface {
public:
    bool parse(std::istream& in);
    boost::shared_ptr<Project> project() const { return project_; }
    const std::string& ident() const { return ident_; }
    const std::string& clientName() const { return clientName_; }
    VelaTime duration() const { return duration_; }
    /// Asset documents carry the fixed version "6.0".
    VersionInfo versionInfo() const override;

private:
    boost::shared_ptr<Project> project_;
    std::string ident_, clientName_;
    VelaTime duration_ = 0;
};

} // namespace VelaMediaLib
