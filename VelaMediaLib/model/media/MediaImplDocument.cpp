// The clip's document object and the parts the document keeps whole.
#include <VelaMediaLib/model/media/MediaImpl.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/media/FileMedia.h>
#include <VelaMediaLib/model/media/MediaTypeFromMediaDispatcher.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {
namespace {

void writeSourceReference(XMLOptions& options, int indent, const MediaImpl& media) {
    const FileMedia* file = dynamic_cast<const FileMedia*>(&media);
    if (!file) return;
    const boost::shared_ptr<const Source> source = file->source();
    if (source) options.key("src") << options.assignNewIdent(source.get());
    writeJSONMember(options, indent, "trackNumber", file->streamIndex());
}

void writeEdgeModifications(XMLOptions& options, int indent, const char* key,
                            const EdgeModifiable::EdgeModifications& modifications) {
    if (modifications.empty()) return;
    options.key(key);
    JSONWriter array(options, indent, JSONWriter::Array);
    for (const EdgeModificationPtr& modification : modifications) {
        options.element();
        modification->toJSON(options, array.memberLevel());
    }
}

void writeEffects(XMLOptions& options, int indent, const Effectable::Effects& effects) {
    if (effects.empty()) return;
    options.key("effects");
    JSONWriter array(options, indent, JSONWriter::Array);
    for (const Effectable::EffectPtr& effect : effects) {
        options.element();
        effect->toJSON(options, array.memberLevel());
    }
}

} // namespace

void MediaImpl::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("id") << options.assignNewIdent(this);
    writeJSONMember(options, members, "_type", MediaTypeFromMediaDispatcher::typeOf(*this));
    writeSourceReference(options, members, *this);
    options.key("attributes");
    {
        JSONWriter attributes(options, members);
        writeJSONMember(options, attributes.memberLevel(), "ident", identifier());
        writeAttributes(options, attributes.memberLevel());
    }
    toJSONSpecificProperties(options, members);
    toJSONTemporalValues(options, members);
    const AnimationTracks animations = animationTracks();
    if (!animations.empty()) {
        options.key("animationTracks");
        JSONWriter tracks(options, members);
        for (const auto& entry : animations) {
            options.key(entry.first);
            entry.second.toJSON(options, tracks.memberLevel());
        }
    }
    toJSONParameterList(options, members);
    writeEffects(options, members, allEffects());
    toJSONFamilyMembers(options, members);
    writeEdgeModifications(options, members, "leftEdgeMods", leftEdgeModifications());
    writeEdgeModifications(options, members, "rightEdgeMods", rightEdgeModifications());
    if (const StoredEffectPtr effect = sourceEffect()) {
        options.key("sourceEffect");
        effect->toJSON(options, members);
    }
    MetaDatable::toJSON(options, members, *this);
}

MediaImpl::AnimationTracks MediaImpl::animationTracks() const {
    ScopedReadLock lock(projectLock());
    return animationTracks_;
}

void MediaImpl::setAnimationTrack(const std::string& name, const AnimationTrack& track) {
    {
        ScopedWriteLock lock(projectMutex());
        const auto found = animationTracks_.find(name);
        if (track.empty()) {
            if (found == animationTracks_.end()) return;
            animationTracks_.erase(found);
        } else {
            const AnimationTrack named(name, track.animations());
            if (found != animationTracks_.end() && found->second == named) return;
            animationTracks_[name] = named;
        }
    }
    notify();
}

StoredEffectPtr MediaImpl::sourceEffect() const {
    ScopedReadLock lock(projectLock());
    return sourceEffect_;
}

void MediaImpl::setSourceEffect(const StoredEffectPtr& effect) {
    {
        ScopedWriteLock lock(projectMutex());
        if (sourceEffect_ == effect) return;
        sourceEffect_ = effect;
    }
    notify();
}

} // namespace VelaMediaLib
