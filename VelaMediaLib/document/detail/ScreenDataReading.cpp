#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/document/detail/ScreenDataReading.h>
#include <VelaMediaLib/model/media/ScreenDataProvider.h>
#include <VelaMediaLib/model/media/ScreenRecordingData.h>

#include <boost/make_shared.hpp>

namespace VelaMediaLib {

namespace {

const Json::Value& entryOf(const Json::Value& entry, unsigned minimum, const char* what) {
    if (!entry.isArray() || entry.size() < minimum) refuseJSONValue(what, entry);
    return entry;
}

} // namespace

void readScreenData(const Json::Value& media, ScreenDataHolder& holder) {
    const Json::Value* screen = optionalMember(media, "screenData");
    if (!screen) return;
    documentObject(*screen, "a screenData object");
    const auto data = boost::make_shared<ScreenRecordingData>();
    if (const Json::Value* rect = optionalMember(*screen, "rect")) {
        jsonArrayOf(*rect, 4, "a rectangle [x, y, width, height]");
        data->setRecordingRect(Rect<int>(jsonValueAsInt((*rect)[0]), jsonValueAsInt((*rect)[1]),
                                         jsonValueAsInt((*rect)[2]), jsonValueAsInt((*rect)[3])));
    }
    if (const Json::Value* cursor = optionalMember(*screen, "cursor"))
        for (const Json::Value& entry : documentArray(*cursor, "an array of cursor samples")) {
            entryOf(entry, 3, "a cursor sample [time, x, y]");
            data->addCursorSample(jsonValueAsRationalTime(entry[0]),
                                  Point3d(jsonValueAsDouble(entry[1]), jsonValueAsDouble(entry[2]), 0));
        }
    if (const Json::Value* clicks = optionalMember(*screen, "clicks"))
        for (const Json::Value& entry : documentArray(*clicks, "an array of clicks")) {
            entryOf(entry, 2, "a click [time, button] or [time, x, y, button]");
            const Json::Value& pressed = entry[entry.size() - 1];
            const int button = jsonValueAsInt(pressed);
            if (button < ScreenClick::Left || button > ScreenClick::Middle)
                refuseJSONValue("a click button (0, 1 or 2)", pressed);
            data->addClick(jsonValueAsRationalTime(entry[0]), ScreenClick::Button(button));
        }
    if (const Json::Value* keys = optionalMember(*screen, "keystrokes"))
        for (const Json::Value& entry : documentArray(*keys, "an array of keystrokes")) {
            entryOf(entry, 2, "a keystroke [time, key, modifiers]");
            const int modifiers = entry.size() > 2 ? jsonValueAsInt(entry[2]) : 0;
            data->addKeystroke(jsonValueAsRationalTime(entry[0]),
                               KeystrokeData(jsonValueAsString(entry[1]), modifiers));
        }
    holder.setScreenData(data);
}

} // namespace VelaMediaLib
