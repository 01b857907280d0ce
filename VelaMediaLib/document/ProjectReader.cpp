#include <VelaMediaLib/document/HotspotReader.h>
#include <VelaMediaLib/document/ProjectReader.h>
#include <VelaMediaLib/document/SourceBinReader.h>
#include <VelaMediaLib/document/TimelineReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/project/Project.h>

#include <boost/make_shared.hpp>

namespace VelaMediaLib {

namespace {

const char* const kProjectAttributes[] = {"title",
                                          "description",
                                          "author",
                                          "targetLoudness",
                                          "shouldApplyLoudnessNormalization",
                                          "videoFormatFrameRate",
                                          "audioFormatSampleRate",
                                          "allowSubFrameEditing"};

/// Clears the project's parsing flag however the read ends.
class ParsingFlag {
public:
    explicit ParsingFlag(Project& project) : project_(project) { project_.setParsingProject(true); }
    ~ParsingFlag() { project_.setParsingProject(false); }
    ParsingFlag(const ParsingFlag&) = delete;
    ParsingFlag& operator=(const ParsingFlag&) = delete;

private:
    Project& project_;
};

} // namespace

ProjectReader::ProjectReader(const boost::shared_ptr<ReadContext>& context,
                             const boost::shared_ptr<FileSystem>& fileSystem)
    : JSONReader(context ? context : boost::make_shared<ReadContext>()), fileSystem_(fileSystem) {}

boost::rational<unsigned long> ProjectReader::readEditRate(const Json::Value& root) {
    const Json::Value* value = optionalMember(root, "editRate");
    if (!value) return boost::rational<unsigned long>(30, 1);
    const SafeRational rate = jsonValueAsVelaRational(*value);
    if (rate <= SafeRational(0)) refuseJSONValue("an editRate greater than 0", *value);
    return boost::rational<unsigned long>(static_cast<unsigned long>(rate.numerator()),
                                          static_cast<unsigned long>(rate.denominator()));
}

void ProjectReader::readProjectAttributes(const Json::Value& root, Project& project) {
    for (const char* key : kProjectAttributes) readAttributeMember(root, key, project);
    readAttributeMember(root, "width", *project.timeline());
    readAttributeMember(root, "height", *project.timeline());
    if (const Json::Value* client = optionalMember(root, "authoringClientName")) {
        documentObject(*client, "an authoringClientName object");
        VersionInfo info;
        if (const Json::Value* name = optionalMember(*client, "name"))
            info.clientName = jsonValueAsString(*name);
        if (const Json::Value* platform = optionalMember(*client, "platform"))
            info.platform = jsonValueAsString(*platform);
        if (const Json::Value* version = optionalMember(*client, "version"))
            info.clientVersion = jsonValueAsString(*version);
        project.setAuthorVersionInfo(info);
    }
}

bool ProjectReader::read(const Json::Value& root) {
    setValue(root);
    documentObject(root, "a project object");
    const boost::shared_ptr<Project> project = Project::create(readEditRate(root));
    context().project = project;
    {
        const ParsingFlag parsing(*project);
        readingWhere("project", [&] { readProjectAttributes(root, *project); });
        if (const Json::Value* sources = optionalMember(root, "sourceBin"))
            SourceBinReader(readContext(), fileSystem_).read(*sources);
        if (const Json::Value* timeline = optionalMember(root, "timeline"))
            TimelineReader(readContext()).read(*timeline);
        readMetaData(root, *project);
        HotspotReader::postProcessHotspots(context());
    }
    project_ = project;
    return true;
}

} // namespace VelaMediaLib
