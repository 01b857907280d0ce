#include <VelaMediaLib/document/HotspotReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/media/HotspotInfo.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>
#include <VelaMediaLib/model/project/Project.h>

namespace VelaMediaLib {

HotspotReader::HotspotReader(const boost::shared_ptr<ReadContext>& context, VisualMedia& media)
    : JSONReader(context), media_(media) {}

HotspotInfo HotspotReader::readHotspot(const Json::Value& value) {
    documentObject(value, "a hotspot object");
    HotspotInfo info;
    if (const Json::Value* action = optionalMember(value, "action")) info.action = jsonValueAsString(*action);
    if (const Json::Value* pause = optionalMember(value, "pauseAtEnd"))
        info.pauseAtEnd = jsonValueAsBool(*pause);
    if (const Json::Value* url = optionalMember(value, "url")) info.url = jsonValueAsString(*url);
    if (const Json::Value* gotoTime = optionalMember(value, "gotoTime"))
        info.gotoTime = jsonValueAsVelaTime(*gotoTime);
    if (const Json::Value* window = optionalMember(value, "openURLInNewWindow"))
        info.openURLInNewWindow = jsonValueAsBool(*window);
    if (const Json::Value* marker = optionalMember(value, "markerParametricId")) {
        const long long id = jsonValueAsInt64(*marker);
        if (id < 0 || id > 0xFFFFFFFFLL) refuseJSONValue("a marker id", *marker);
        info.readMarkerId = static_cast<unsigned>(id);
    }
    if (const Json::Value* time = optionalMember(value, "markerTime"))
        info.markerTime = jsonValueAsVelaTime(*time);
    if (const Json::Value* last = optionalMember(value, "lastMarkerGlobalTime"))
        info.lastMarkerGlobalTime = jsonValueAsVelaTime(*last);
    return info;
}

bool HotspotReader::read(const Json::Value& value) {
    setValue(value);
    auto* media = dynamic_cast<VisualMediaImpl*>(&media_);
    if (!media) return false;
    const HotspotInfo info = readHotspot(value);
    media->setHotspot(info);
    if (info.readMarkerId != 0)
        context().hotspots.emplace_back(boost::dynamic_pointer_cast<VisualMedia>(media->shared_from_this()),
                                        info.readMarkerId);
    return true;
}

void HotspotReader::postProcessHotspots(ReadContext& context) {
    for (const auto& pending : context.hotspots) {
        const auto media = boost::dynamic_pointer_cast<VisualMediaImpl>(pending.first.lock());
        if (!media) continue;
        boost::shared_ptr<Parametric> target;
        const auto found = context.medias.find(pending.second);
        if (found != context.medias.end())
            target = found->second;
        else if (context.hasTimelineId && context.timelineId == pending.second && context.project)
            target = context.project->timeline();
        if (!target) refuseDocument("hotspot marker refers to no object: " + std::to_string(pending.second));
        boost::optional<HotspotInfo> info = media->hotspot();
        if (!info) continue;
        info->markerTarget = target;
        info->readMarkerId = 0;
        media->setHotspot(info);
    }
    context.hotspots.clear();
}

} // namespace VelaMediaLib
