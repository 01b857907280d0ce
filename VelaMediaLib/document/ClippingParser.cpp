#include <VelaMediaLib/document/ClippingParser.h>
#include <VelaMediaLib/document/HotspotReader.h>
#include <VelaMediaLib/document/MixerReader.h>
#include <VelaMediaLib/document/ProjectReader.h>
#include <VelaMediaLib/document/SourceBinReader.h>
#include <VelaMediaLib/document/detail/DocumentParsing.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>

#include <boost/make_shared.hpp>

namespace VelaMediaLib {

ClippingParser::ClippingParser(const boost::shared_ptr<Project>& project) : project_(project) {
    versionInfo_.version = "6.0";
}

namespace {

struct ClippingRead {
    std::vector<SourcePtr> added;
    std::vector<MixerPtr> mixers;
};

ClippingRead readClippings(const Json::Value& root, const boost::shared_ptr<ReadContext>& context) {
    Project& project = *context->project;
    if (ProjectReader::readEditRate(root) != project.editRate())
        refuseDocument("clipping of another edit rate");
    ClippingRead read;
    if (const Json::Value* sources = optionalMember(root, "sourceBin"))
        for (const Json::Value& entry : documentArray(*sources, "an array of source entries")) {
            documentObject(entry, "a source entry");
            const long long id = jsonValueAsInt64(requiredMember(entry, "id", "a source entry"));
            context->takeId(id);
            const auto stats = SourceBinReader::readStats(entry);
            SourcePtr source = project.sourceBin()->sourceForFile(stats->filename());
            for (const SourcePtr& added : read.added) // two entries of one file make one source
                if (!source && added->filename() == stats->filename()) source = added;
            if (!source) {
                source = Source::create(project.editRateToken(), project.token(), stats);
                read.added.push_back(source);
            }
            context->sources[id] = source;
        }
    std::vector<const Json::Value*> clippings;
    if (const Json::Value* tracks = optionalMember(root, "tracks")) clippings.push_back(tracks);
    if (const Json::Value* many = optionalMember(root, "clippings"))
        for (const Json::Value& clipping : documentArray(*many, "an array of clippings"))
            clippings.push_back(
                &requiredMember(documentObject(clipping, "a clipping"), "tracks", "a clipping"));
    for (const Json::Value* tracks : clippings) {
        const auto mixer = GenericMixer::create(project.token());
        MixerReader(context, mixer).read(*tracks);
        read.mixers.push_back(mixer);
    }
    HotspotReader::postProcessHotspots(*context);
    return read;
}

} // namespace

bool ClippingParser::read(std::istream& in) {
    const Json::Value root = parseDocument(in);
    const VersionInfo info = parsingDocument([&] { return documentVersionInfo(root); });
    const auto context = boost::make_shared<ReadContext>();
    context->project = project_;
    ClippingRead read = parsingDocument([&] { return readClippings(root, context); });
    clippings_ = std::move(read.mixers);
    newSources_ = std::move(read.added);
    versionInfo_ = info;
    return true;
}

bool ClippingParser::parse(std::istream& in) {
    ClippingParser reading(project_);
    reading.read(in);
    // Only now does the project change: the sources first, taken out again if one is refused.
    std::vector<SourcePtr> inserted;
    try {
        for (const SourcePtr& source : reading.newSources()) {
            project_->sourceBin()->insertSource(source, -1);
            inserted.push_back(source);
        }
    } catch (const std::exception& e) {
        for (const SourcePtr& source : inserted) project_->sourceBin()->removeSource(source);
        refuseDocument(e.what());
    }
    for (const MixerPtr& mixer : reading.clippings()) project_->addClipping(mixer);
    clippings_ = reading.clippings();
    newSources_ = reading.newSources();
    versionInfo_ = reading.versionInfo();
    return true;
}

} // namespace VelaMediaLib
