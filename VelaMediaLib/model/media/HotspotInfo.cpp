#include <VelaMediaLib/model/media/HotspotInfo.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/parameters/Parametric.h>

namespace VelaMediaLib {

void HotspotInfo::toJSON(XMLOptions& options, int indent) const { toJSON(options, indent, true); }

void HotspotInfo::toJSON(XMLOptions& options, int indent, bool targetWritten) const {
    const boost::shared_ptr<Parametric> target = markerTarget.lock();
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("action");
    writeJSONValue(options, members, action);
    options.key("pauseAtEnd");
    writeJSONValue(options, members, pauseAtEnd);
    options.key("url");
    writeJSONValue(options, members, url);
    options.key("gotoTime");
    writeJSONValue(options, members, (long long)gotoTime);
    options.key("openURLInNewWindow");
    writeJSONValue(options, members, openURLInNewWindow);
    options.key("markerParametricId")
        << (target && targetWritten ? options.assignNewIdent(target.get()) : 0u);
    options.key("markerTime");
    writeJSONValue(options, members, (long long)markerTime);
    options.key("lastMarkerGlobalTime");
    writeJSONValue(options, members, (long long)lastMarkerGlobalTime);
}

bool HotspotInfo::operator==(const HotspotInfo& other) const {
    return action == other.action && pauseAtEnd == other.pauseAtEnd && url == other.url &&
           gotoTime == other.gotoTime && openURLInNewWindow == other.openURLInNewWindow &&
           markerTarget.lock() == other.markerTarget.lock() && markerTime == other.markerTime &&
           lastMarkerGlobalTime == other.lastMarkerGlobalTime;
}

} // namespace VelaMediaLib
