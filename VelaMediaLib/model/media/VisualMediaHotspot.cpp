// A visual clip's hotspot: kept under the project lock, cloned and written with the clip.
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/timeline/Timeline.h>

namespace VelaMediaLib {

boost::optional<HotspotInfo> VisualMediaImpl::hotspot() const {
    ScopedReadLock lock(projectLock());
    return hotspot_;
}

void VisualMediaImpl::setHotspot(const boost::optional<HotspotInfo>& hotspot) {
    {
        ScopedWriteLock lock(projectMutex());
        if (hotspot_ == hotspot) return;
        hotspot_ = hotspot;
    }
    notify();
}

void VisualMediaImpl::copyFamilyContentInto(MediaImpl& clone) const {
    if (auto* visual = dynamic_cast<VisualMediaImpl*>(&clone)) visual->hotspot_ = hotspot();
}

namespace {

// A marker target is named only when it is written in the same document: the
// clip's own timeline, or a clip on it. Any other would be an id of nothing.
bool targetInDocument(const boost::shared_ptr<Parametric>& target, const Media& media) {
    const boost::shared_ptr<Timeline> timeline = media.parentTimeline().lock();
    if (!target || !timeline) return false;
    if (dynamic_cast<Timeline*>(target.get()) == timeline.get()) return true;
    const Media* clip = dynamic_cast<Media*>(target.get());
    return clip && clip->parentTimeline().lock() == timeline;
}

} // namespace

void VisualMediaImpl::toJSONFamilyMembers(XMLOptions& options, int indent) const {
    const boost::optional<HotspotInfo> info = hotspot();
    if (!info) return;
    options.key("hotspot");
    info->toJSON(options, indent, targetInDocument(info->markerTarget.lock(), *this));
}

} // namespace VelaMediaLib
