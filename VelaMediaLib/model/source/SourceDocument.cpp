// A source's entry in the document's "sourceBin": the recorded stats, so that
// a read source is built from them without reading the file.
#include <VelaMediaLib/model/source/Source.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>

namespace VelaMediaLib {
namespace {

void writeRect(XMLOptions& options, const Rect<int>& rect) {
    const char* separator = options.inlineSeparator();
    options.stream() << "[" << rect.x << separator << rect.y << separator << rect.width << separator
                     << rect.height << "]";
}

SafeRational rationalOf(const boost::rational<unsigned long>& rate) {
    return SafeRational((long long)rate.numerator(), (long long)rate.denominator());
}

void writeStream(XMLOptions& options, int indent, const TrackStats& stream) {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("type");
    writeJSONValue(options, members, std::string(trackTypeName(stream.type)));
    options.key("range");
    writeJSONValue(options, members, stream.range);
    options.key("editRate");
    writeJSONValue(options, members, rationalOf(stream.rangeEditRate));
    options.key("trackRect");
    writeRect(options, stream.rect);
    options.key("sampleRate");
    writeJSONValue(options, members, stream.sampleRate);
    options.key("bitDepth");
    writeJSONValue(options, members, stream.bitDepth);
    options.key("numChannels");
    writeJSONValue(options, members, stream.numChannels);
    options.key("integratedLUFS");
    writeJSONValue(options, members, stream.integratedLUFS);
    options.key("peakLevel");
    writeJSONValue(options, members, stream.peakLevel);
    options.key("metaData");
    {
        JSONWriter array(options, members, JSONWriter::Array);
        for (const std::string& entry : stream.metaData) {
            options.element();
            writeJSONValue(options, array.memberLevel(), entry);
        }
    }
    options.key("orientation");
    writeJSONValue(options, members, int(stream.orientation));
    if (!stream.filename.empty()) {
        options.key("filename");
        writeJSONValue(options, members, options.modifyPath(stream.filename));
    }
    options.key("fileTrackNumber");
    writeJSONValue(options, members, stream.fileTrackNumber);
}

} // namespace

void Source::toJSON(XMLOptions& options, int indent) const {
    const MediaFileStats::Contents contents = stats()->contents();
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("id") << options.assignNewIdent(this);
    options.key("src");
    writeJSONValue(options, members, options.modifyPath(contents.filename));
    options.key("rect");
    writeRect(options, contents.rect);
    options.key("lastMod");
    writeJSONValue(options, members, 0LL); // the stats record no modification time
    options.key("sourceTracks");
    {
        JSONWriter array(options, members, JSONWriter::Array);
        for (const TrackStats& stream : contents.tracks) {
            options.element();
            writeStream(options, array.memberLevel(), stream);
        }
    }
    if (const auto loudness = shouldApplyLoudnessNormalizationAttribute()) {
        options.key("loudnessNormalization");
        writeJSONValue(options, members, loudness->value());
    }
    MetaDatable::toJSON(options, members, *this);
}

} // namespace VelaMediaLib
