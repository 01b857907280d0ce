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
    writeJSONMember(options, members, "type", std::string(trackTypeName(stream.type)));
    writeJSONMember(options, members, "range", stream.range);
    writeJSONMember(options, members, "editRate", rationalOf(stream.rangeEditRate));
    options.key("trackRect");
    writeRect(options, stream.rect);
    writeJSONMember(options, members, "sampleRate", stream.sampleRate);
    writeJSONMember(options, members, "bitDepth", stream.bitDepth);
    writeJSONMember(options, members, "numChannels", stream.numChannels);
    writeJSONMember(options, members, "integratedLUFS", stream.integratedLUFS);
    writeJSONMember(options, members, "peakLevel", stream.peakLevel);
    options.key("metaData");
    {
        JSONWriter array(options, members, JSONWriter::Array);
        for (const std::string& entry : stream.metaData) {
            options.element();
            writeJSONValue(options, array.memberLevel(), entry);
        }
    }
    writeJSONMember(options, members, "orientation", int(stream.orientation));
    if (!stream.filename.empty()) {
        writeJSONMember(options, members, "filename", options.modifyPath(stream.filename));
    }
    writeJSONMember(options, members, "fileTrackNumber", stream.fileTrackNumber);
}

} // namespace

void Source::toJSON(XMLOptions& options, int indent) const {
    const MediaFileStats::Contents contents = stats()->contents();
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("id") << options.assignNewIdent(this);
    writeJSONMember(options, members, "src", options.modifyPath(contents.filename));
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
        writeJSONMember(options, members, "loudnessNormalization", loudness->value());
    }
    MetaDatable::toJSON(options, members, *this);
}

} // namespace VelaMediaLib
