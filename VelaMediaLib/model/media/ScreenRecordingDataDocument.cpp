// A screen recording's cursor, clicks and keys as the "screenData" of its clip.
#include <VelaMediaLib/model/media/ScreenDataProvider.h>
#include <VelaMediaLib/model/media/ScreenRecordingData.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

namespace VelaMediaLib {
namespace {

// Writes an array of the entries, each on one line as the row writer makes it.
template <typename Entries, typename Row>
void writeRows(XMLOptions& options, int indent, const char* key, const Entries& entries, Row row) {
    options.key(key);
    JSONWriter array(options, indent, JSONWriter::Array);
    for (const auto& entry : entries) {
        options.element() << "[";
        writeJSONValue(options, array.memberLevel(), entry.time);
        options.stream() << options.inlineSeparator();
        row(entry);
        options.stream() << "]";
    }
}

} // namespace

void ScreenRecordingData::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    const char* separator = options.inlineSeparator();
    options.key("recordingRect") << "[" << rect_.x << separator << rect_.y << separator << rect_.width
                                 << separator << rect_.height << "]";
    writeRows(options, members, "cursor", cursor_, [&](const ScreenCursorSample& sample) {
        options.stream() << formatDouble(sample.position.x) << separator << formatDouble(sample.position.y);
    });
    writeRows(options, members, "clicks", clicks_,
              [&](const ScreenClick& click) { options.stream() << int(click.button); });
    writeRows(options, members, "keystrokes", keys_, [&](const ScreenKeystroke& key) {
        ValueTraits<KeystrokeData>::write(options, members, key.keystroke);
    });
}

void writeScreenData(XMLOptions& options, int indent, const ScreenDataHolder& holder) {
    const boost::shared_ptr<const ScreenRecordingData> data = holder.screenData();
    if (!data || data->isEmpty()) return;
    options.key("screenData");
    data->toJSON(options, indent);
}

} // namespace VelaMediaLib
