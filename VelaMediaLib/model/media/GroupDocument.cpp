// A group's own members of its document object.
#include <VelaMediaLib/model/media/Group.h>

#include <VelaMediaLib/document/format/JSONWriter.h>

namespace VelaMediaLib {

void Group::toJSONSpecificProperties(XMLOptions& options, int indent) const {
    toJSONVelaML(options, indent);
    const JSONTree properties = assetProperties();
    if (properties.isEmpty()) return;
    options.key("assetProperties");
    properties.write(options, indent);
}

// Inner tracks carry their flags themselves: no "trackAttributes" lists them.
void Group::toJSONVelaML(XMLOptions& options, int indent) const {
    const Mixer::Tracks tracks = mixer_->tracks();
    options.key("tracks");
    JSONWriter array(options, indent, JSONWriter::Array);
    for (size_t index = 0; index < tracks.size(); ++index) {
        options.element();
        tracks[index]->toJSON(options, array.memberLevel(), int(index), true);
    }
}

JSONTree Group::assetProperties() const {
    ScopedReadLock lock(projectLock());
    return assetProperties_;
}

void Group::setAssetProperties(const JSONTree& properties) {
    {
        ScopedWriteLock lock(projectMutex());
        if (assetProperties_ == properties) return;
        assetProperties_ = properties;
    }
    notify();
}

} // namespace VelaMediaLib
