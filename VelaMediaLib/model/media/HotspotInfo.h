#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <boost/weak_ptr.hpp>
#include <string>

namespace VelaMediaLib {

class Parametric;
class XMLOptions;

/// What happens when a viewer clicks a visual clip: an action by name, a
/// pause at the clip's end, a link to open, a time to go to, or a marker of
/// a clip or of the timeline to jump to. A value: the clip keeps a copy under
/// the project lock. The marker's owner is held weakly (it belongs to the
/// timeline, not to the hotspot).
struct VELAMEDIALIB_API HotspotInfo {
    std::string action;
    bool pauseAtEnd = false;
    std::string url;
    VelaTime gotoTime = 0;
    bool openURLInNewWindow = false;
    /// The clip or timeline whose marker the hotspot jumps to, if any.
    boost::weak_ptr<Parametric> markerTarget;
    VelaTime markerTime = 0;
    VelaTime lastMarkerGlobalTime = 0;
    /// The "markerParametricId" as a document gave it, until
    /// HotspotReader::postProcessHotspots resolves it into markerTarget.
    /// Writers ignore it: they write the target's id in their own write.
    unsigned readMarkerId = 0;

    /// The hotspot's object, closed at indent: "action", "pauseAtEnd", "url",
    /// "gotoTime", "openURLInNewWindow", "markerParametricId" (the target's id
    /// in this write, 0 without a target), "markerTime", "lastMarkerGlobalTime".
    /// A target gets its id here when it is written later: it keeps it then.
    void toJSON(XMLOptions& options, int indent) const;
    /// The same, with markerParametricId 0 unless the target may be named:
    /// the writer of a clip passes whether the target belongs to the document.
    void toJSON(XMLOptions& options, int indent, bool targetWritten) const;

    /// Same fields and the same target.
    bool operator==(const HotspotInfo& other) const;
    bool operator!=(const HotspotInfo& other) const { return !(*this == other); }
};

} // namespace VelaMediaLib
