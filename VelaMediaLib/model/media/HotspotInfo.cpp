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
    writeJSONMember(options, members, "action", action);
    writeJSONMember(options, members, "pauseAtEnd", pauseAtEnd);
    writeJSONMember(options, members, "url", url);
    writeJSONMember(options, members, "gotoTime", (long long)gotoTime);
    writeJSONMember(options, members, "openURLInNewWindow", openURLInNewWindow);
    options.key("markerParametricId")
        << (target && targetWritten ? options.assignNewIdent(target.get()) : 0u);
    writeJSONMember(options, members, "markerTime", (long long)markerTime);
    writeJSONMember(options, members, "lastMarkerGlobalTime", (long long)lastMarkerGlobalTime);
}

bool HotspotInfo::operator==(const HotspotInfo& other) const {
    return action == other.action && pauseAtEnd == other.pauseAtEnd && url == other.url &&
           gotoTime == other.gotoTime && openURLInNewWindow == other.openURLInNewWindow &&
           markerTarget.lock() == other.markerTarget.lock() && markerTime == other.markerTime &&
           lastMarkerGlobalTime == other.lastMarkerGlobalTime;
}

} // namespace VelaMediaLib
