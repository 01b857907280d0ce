// A track's document object and its "trackAttributes" entry.
#include <VelaMediaLib/model/timeline/Track.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>

#include <set>

namespace VelaMediaLib {
namespace {

const char* const kFlagNames[] = {"audioMuted", "videoHidden", "magnetic", "matte", "solo"};

// Every transition at an edge of the clips, in clip order, each once (two
// touching clips share theirs).
std::vector<TransitionPtr> transitionsOf(const std::vector<MediaPtr>& medias) {
    std::vector<TransitionPtr> found;
    std::set<Transition*> seen;
    for (const MediaPtr& media : medias)
        for (const TransitionPtr& transition : {media->leftTransition(), media->rightTransition()})
            if (transition && seen.insert(transition.get()).second) found.push_back(transition);
    return found;
}

} // namespace

void Track::toJSON(XMLOptions& options, int indent, int trackIndex, bool withFlags) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    writeJSONMember(options, members, "trackIndex", trackIndex);
    const std::vector<MediaPtr> clips = medias();
    {
        options.key("medias");
        JSONWriter array(options, members, JSONWriter::Array);
        for (const MediaPtr& media : clips) {
            options.element();
            media->toJSON(options, array.memberLevel());
        }
    }
    {
        options.key("transitions");
        JSONWriter array(options, members, JSONWriter::Array);
        for (const TransitionPtr& transition : transitionsOf(clips)) {
            options.element();
            transition->toJSON(options, array.memberLevel(), this);
        }
    }
    const Effects effects = allEffects();
    if (!effects.empty()) {
        options.key("effects");
        JSONWriter array(options, members, JSONWriter::Array);
        for (const EffectPtr& effect : effects) {
            options.element();
            effect->toJSON(options, array.memberLevel());
        }
    }
    if (hasMadeParameters()) toJSONParameterList(options, members); // a track's volume curve
    if (withFlags) {
        writeJSONMember(options, members, "ident", identifier());
        for (const char* flag : kFlagNames) {
            options.key(flag);
            writeJSONValue(options, members, attributeValue<bool>(flag, false));
        }
    }
    MetaDatable::toJSON(options, members, *this);
}

void Track::toJSONTrackAttributes(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    writeJSONMember(options, object.memberLevel(), "ident", identifier());
    for (const char* flag : kFlagNames) {
        options.key(flag);
        writeJSONValue(options, object.memberLevel(), attributeValue<bool>(flag, false));
    }
    MetaDatable::toJSON(options, object.memberLevel(), *this);
}

} // namespace VelaMediaLib
