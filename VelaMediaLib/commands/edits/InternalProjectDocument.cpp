// The project document's root object. The writer reads the model only, each
// value under the project's read lock on its own, so other threads may read
// while a document is written.
#include <VelaMediaLib/commands/edits/InternalProject.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {
namespace {

void writeClient(XMLOptions& options, int indent, const VersionInfo& info) {
    options.key("authoringClientName");
    JSONWriter object(options, indent);
    writeJSONMember(options, object.memberLevel(), "name", info.clientName);
    writeJSONMember(options, object.memberLevel(), "platform", info.platform);
    writeJSONMember(options, object.memberLevel(), "version", info.clientVersion);
}

bool isClientKey(const std::string& key) { return key.rfind("authoringClientName:", 0) == 0; }

// The project's metadata without the client keys, which "authoringClientName"
// carries: a read project holds them whether or not the writer had any.
void writeMetaData(XMLOptions& options, int indent, const std::map<std::string, std::string>& entries) {
    bool any = false;
    for (const auto& entry : entries) any = any || !isClientKey(entry.first);
    if (!any) return;
    options.key("metadata");
    JSONWriter object(options, indent);
    for (const auto& entry : entries) {
        if (isClientKey(entry.first)) continue;
        options.key(entry.first);
        writeJSONValue(options, object.memberLevel(), entry.second);
    }
}

} // namespace

void InternalProject::toJSON(XMLOptions& options) const {
    JSONWriter root(options, 0);
    const int members = root.memberLevel();
    writeAttributeMember(options, members, "title", titleAttribute());
    writeAttributeMember(options, members, "description", descriptionAttribute());
    writeAttributeMember(options, members, "author", authorAttribute());
    writeAttributeMember(options, members, "targetLoudness", targetLoudnessAttribute());
    writeAttributeMember(options, members, "shouldApplyLoudnessNormalization",
                         shouldApplyLoudnessNormalizationAttribute());
    writeAttributeMember(options, members, "videoFormatFrameRate", videoFormatFrameRateAttribute());
    writeAttributeMember(options, members, "audioFormatSampleRate", audioFormatSampleRateAttribute());
    writeAttributeMember(options, members, "allowSubFrameEditing", allowSubFrameEditingAttribute());
    writeAttributeMember(options, members, "width", timeline_->attributeWidth());
    writeAttributeMember(options, members, "height", timeline_->attributeHeight());
    writeJSONMember(options, members, "version", std::string(documentVersion()));
    const boost::rational<unsigned long> rate = editRate();
    options.key("editRate");
    writeJSONValue(options, members,
                   SafeRational((long long)rate.numerator(), (long long)rate.denominator()));
    writeClient(options, members, authorVersionInfo());
    options.key("sourceBin");
    sourceBin_->toJSON(options, members);
    options.key("timeline");
    timeline_->toJSON(options, members);
    writeMetaData(options, members, metaDataCopy());
    root.close();
    if (!options.compact()) options.stream() << "\n";
}

} // namespace VelaMediaLib
