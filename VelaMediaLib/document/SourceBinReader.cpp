#include <VelaMediaLib/document/ChangedFileHandler.h>
#include <VelaMediaLib/document/MissingFileHandler.h>
#include <VelaMediaLib/document/SourceBinReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/source/BoostFileSystem.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {

namespace {

Rect<int> readRect(const Json::Value& value) {
    jsonArrayOf(value, 4, "a rectangle [x, y, width, height]");
    return Rect<int>(jsonValueAsInt(value[0]), jsonValueAsInt(value[1]), jsonValueAsInt(value[2]),
                     jsonValueAsInt(value[3]));
}

boost::rational<unsigned long> readRate(const Json::Value& value) {
    const SafeRational rate = jsonValueAsVelaRational(value);
    if (rate <= SafeRational(0)) refuseJSONValue("a rate greater than 0", value);
    return boost::rational<unsigned long>(static_cast<unsigned long>(rate.numerator()),
                                          static_cast<unsigned long>(rate.denominator()));
}

template <typename T, typename Read>
void readField(const Json::Value& object, const char* key, T& field, Read read) {
    if (const Json::Value* value = optionalMember(object, key)) field = read(*value);
}

TrackStats readTrackStats(const Json::Value& value) {
    documentObject(value, "a sourceTracks entry");
    TrackStats track;
    if (const Json::Value* type = optionalMember(value, "type"))
        if (!trackTypeFromName(jsonValueAsString(*type), track.type)) refuseJSONValue("a stream type", *type);
    readField(value, "range", track.range, jsonValueAsTickRange);
    readField(value, "editRate", track.rangeEditRate, readRate);
    readField(value, "trackRect", track.rect, readRect);
    readField(value, "sampleRate", track.sampleRate, JSONReader::jsonValueAsVelaRational);
    readField(value, "bitDepth", track.bitDepth, jsonValueAsInt);
    readField(value, "numChannels", track.numChannels, jsonValueAsInt);
    readField(value, "integratedLUFS", track.integratedLUFS, jsonValueAsDouble);
    readField(value, "peakLevel", track.peakLevel, jsonValueAsDouble);
    if (const Json::Value* orientation = optionalMember(value, "orientation")) {
        const int turned = jsonValueAsInt(*orientation);
        if (turned < 0 || turned > 3) refuseJSONValue("an orientation from 0 to 3", *orientation);
        track.orientation = MediaOrientation(turned);
    }
    if (const Json::Value* lines = optionalMember(value, "metaData"))
        for (const Json::Value& line : documentArray(*lines, "an array of strings"))
            track.metaData.push_back(jsonValueAsString(line));
    readField(value, "filename", track.filename, jsonValueAsString);
    readField(value, "fileTrackNumber", track.fileTrackNumber, jsonValueAsInt);
    return track;
}

} // namespace

SourceBinReader::SourceBinReader(const boost::shared_ptr<ReadContext>& context,
                                 const boost::shared_ptr<FileSystem>& fileSystem)
    : JSONReader(context), fileSystem_(fileSystem ? fileSystem : BoostFileSystem::instance()) {}

bool SourceBinReader::read(const Json::Value& sources) {
    setValue(sources);
    for (const Json::Value& entry : documentArray(sources, "an array of source entries")) readSource(entry);
    return true;
}

boost::shared_ptr<MediaFileStats> SourceBinReader::readStats(const Json::Value& entry) {
    MediaFileStats::Contents contents;
    contents.filename = jsonValueAsString(requiredMember(entry, "src", "a source entry"));
    if (const Json::Value* rect = optionalMember(entry, "rect")) contents.rect = readRect(*rect);
    if (const Json::Value* tracks = optionalMember(entry, "sourceTracks"))
        for (const Json::Value& track : documentArray(*tracks, "an array of sourceTracks"))
            contents.tracks.push_back(readTrackStats(track));
    const boost::shared_ptr<MediaFileStats> stats = MediaFileStats::create();
    stats->setContents(contents);
    return stats;
}

void SourceBinReader::readSource(const Json::Value& entry) {
    documentObject(entry, "a source entry");
    const long long id = jsonValueAsInt64(requiredMember(entry, idTagName(), "a source entry"));
    context().takeId(id);
    Project& project = *context().project;
    const boost::shared_ptr<MediaFileStats> recorded = readStats(entry);
    const SourcePtr source = readingWhere("source " + std::to_string(id), [&] {
        const SourcePtr made =
            Source::create(project.editRateToken(), project.token(), recorded, fileSystem_);
        if (const Json::Value* loudness = optionalMember(entry, "loudnessNormalization"))
            made->addAttribute<bool>("shouldApplyLoudnessNormalization", jsonValueAsBool(*loudness));
        if (const Json::Value* lastMod = optionalMember(entry, "lastMod")) jsonValueAsInt64(*lastMod);
        // A read source was added when its document says, not now.
        made->removeMetaData(Source::timeAddedMetaDataKey());
        readMetaData(entry, *made);
        project.sourceBin()->insertSource(made, -1);
        return made;
    });
    context().sources[id] = source;
    checkFile(*source, *recorded);
}

void SourceBinReader::checkFile(Source& source, const MediaFileStats& recorded) const {
    if (!context().checkFiles) return;
    const std::string path = recorded.filename();
    if (!fileSystem_->isReadable(path)) {
        const auto& handler = context().missingFileHandler;
        if (handler && !handler->handleInaccessibleFile(path))
            throw ParserException("Load cancelled: " + path);
        source.setOnline(false);
        return;
    }
    boost::shared_ptr<MediaFileStats> present;
    try {
        present = MediaFileStats::create(path);
    } catch (const std::exception&) {
        return; // no loader can say: taken as unchanged
    }
    if (present->contents() == recorded.contents()) return;
    const auto& handler = context().changedFileHandler;
    if (handler && !handler->handleChangedFile(path, recorded, *present))
        throw ParserException("Load cancelled: " + path);
}

} // namespace VelaMediaLib
