#include <VelaMediaLib/document/AnimationTrackReader.h>
#include <VelaMediaLib/document/EdgeModReader.h>
#include <VelaMediaLib/document/HotspotReader.h>
#include <VelaMediaLib/document/MediaReader.h>
#include <VelaMediaLib/document/detail/EffectReading.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/model/media/VisualMedia.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <limits>

namespace VelaMediaLib {

namespace {

// Track times stay far from the 64-bit ends, so that no sum of a start and a
// length a track or an edit forms can overflow.
constexpr long long kTimeLimit = std::numeric_limits<long long>::max() / 4;

void checkTime(long long time, const char* name) {
    if (time > kTimeLimit || time < -kTimeLimit)
        throw ValueException<long long>(std::string(name) + " out of range", time);
}

} // namespace

bool MediaReader::read(const Json::Value& value) {
    setValue(value);
    documentObject(value, "a media object");
    const NestingGuard nesting(context());
    long long id = 0;
    const Json::Value* idValue = optionalMember(value, idTagName());
    if (idValue) {
        id = jsonValueAsInt64(*idValue);
        context().takeId(id);
        where_ = "media " + std::to_string(id);
    }
    media_ = readingWhere(where_, [&] {
        const MediaState timing = readTiming(value);
        const boost::shared_ptr<Media> media = createMedia(value, timing);
        readCommon(value, *media);
        readSpecificProperties(value, *media);
        takeTiming(*media, timing);
        return media;
    });
    if (idValue) context().medias[id] = media_;
    return true;
}

MediaState MediaReader::readTiming(const Json::Value& value) const {
    MediaState timing;
    timing.start = jsonValueAsVelaTime(requiredMember(value, "start", where_.c_str()));
    timing.duration = jsonValueAsVelaTime(requiredMember(value, "duration", where_.c_str()));
    checkTime(timing.start, "start");
    checkTime(timing.duration, "duration");
    if (timing.duration <= 0) throw ValueException<long long>("duration not greater than 0", timing.duration);
    const Json::Value* mediaStart = optionalMember(value, "mediaStart");
    const Json::Value* mediaDuration = optionalMember(value, "mediaDuration");
    const Json::Value* scalar = optionalMember(value, "scalar");
    timing.mediaStart = mediaStart ? jsonValueAsVelaRational(*mediaStart) : SafeRational(0);
    timing.mediaDuration =
        mediaDuration ? jsonValueAsVelaRational(*mediaDuration) : SafeRational(timing.duration);
    timing.scalar = scalar ? jsonValueAsVelaRational(*scalar) : SafeRational(1);
    checkTime(timing.mediaStart.asVelaTime(), "mediaStart");
    checkTime(timing.mediaDuration.asVelaTime(), "mediaDuration");
    if (timing.mediaDuration < SafeRational(0))
        throw ValueException<const SafeRational>("mediaDuration less than 0", timing.mediaDuration);
    if (timing.scalar <= SafeRational(0))
        throw ValueException<const SafeRational>("scalar not greater than 0", timing.scalar);
    if (const Json::Value* trimStartSum = optionalMember(value, "trimStartSum"))
        jsonValueAsVelaTime(*trimStartSum); // accepted; the model keeps no such sum
    if (hasMediaExtent() &&
        RationalUtil::Round(timing.mediaDuration * timing.scalar) != SafeRational(timing.duration))
        throw ValueException<long long>("duration is not mediaDuration times scalar", timing.duration);
    return timing;
}

void MediaReader::readCommon(const Json::Value& value, Media& media) {
    if (const Json::Value* attributes = optionalMember(value, "attributes")) {
        documentObject(*attributes, "an object of attributes");
        if (const Json::Value* ident = optionalMember(*attributes, "ident"))
            media.setIdentifier(jsonValueAsString(*ident));
        readOtherAttributes(*attributes, media);
        std::vector<const char*> skipped(otherAttributeNames());
        skipped.push_back("ident");
        readAttributeMembers(*attributes, media, skipped);
    }
    readParametersEffectsAndMetaData(value, media);
    if (const Json::Value* tracks = optionalMember(value, "animationTracks"))
        AnimationTrackReader(readContext(), media).read(*tracks);
    if (const Json::Value* hotspot = optionalMember(value, "hotspot")) {
        auto* visual = dynamic_cast<VisualMedia*>(&media);
        if (!visual) refuseDocument(where_ + ": a hotspot on a clip that shows no picture");
        HotspotReader(readContext(), *visual).read(*hotspot);
    }
    if (const Json::Value* left = optionalMember(value, "leftEdgeMods"))
        LeftEdgeModReader(readContext(), media).read(*left);
    if (const Json::Value* right = optionalMember(value, "rightEdgeMods"))
        RightEdgeModReader(readContext(), media).read(*right);
    readSourceEffect(value, media);
}

void MediaReader::readOtherAttributes(const Json::Value&, Media&) {}

void MediaReader::readSpecificProperties(const Json::Value&, Media&) {}

// The kinds build their clips from the document's values; where a kind's
// own rules left a value elsewhere, the clip takes the document's now.
void MediaReader::takeTiming(Media& media, const MediaState& timing) const {
    MediaState state = media.state();
    const MediaState built = state;
    state.start = timing.start;
    state.duration = timing.duration;
    state.mediaStart = timing.mediaStart;
    state.mediaDuration = timing.mediaDuration;
    state.scalar = timing.scalar;
    if (state != built) media.restoreState(state, 0);
}

} // namespace VelaMediaLib
