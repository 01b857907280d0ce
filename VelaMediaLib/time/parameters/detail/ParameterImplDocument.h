#pragma once
// ParameterImpl: the document form. A parameter is written bare (its value
// alone) or as an object with "type", "interp", "valueBounds", "uiHints" and
// "keyframes", each where it applies. Reading goes into a scratch copy that
// takes this parameter's place only when the whole value was read.

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>

#include <json/value.h>

namespace VelaMediaLib {

namespace ParameterDocument {

/// Whether a document value is a parameter object rather than a bare value
/// (no value type's own JSON form uses these keys).
inline bool isParameterObject(const Json::Value& json) {
    return json.isObject() && (json.isMember("keyframes") || json.isMember("type") ||
                               json.isMember("edits") || json.isMember("valueBounds"));
}

inline std::string requiredString(const Json::Value& json, const char* what) {
    if (!json.isString())
        throw ParserException(std::string("Invalid project json - expected a string for ") + what);
    return json.asString();
}

} // namespace ParameterDocument

template <typename T>
bool ParameterImpl<T>::writtenBare(const std::string& name, const std::string& typeName) const {
    if (!typeName.empty() && typeName != parameterTypeString()) return false;
    if (namesWrittenInFull().count(name)) return false;
    if (keyframes_.size() != 1 || describedBeyondTheCurve()) return false;
    const std::string interp = parameterInterpolaterName();
    if (!interp.empty() && interp != InterpolaterFactory<T>::defaultInterpolater()->name()) return false;
    const KeyFrame<T>& only = *keyframes_.front().keyframe;
    return keyframes_.front().time == RationalTime(0) && only.leadIn_ == RationalTime(0) &&
           !only.interpolater_ && only.metaDataKeys().empty();
}

template <typename T>
void ParameterImpl<T>::toJSON(XMLOptions& options, int indent, const std::string& name,
                              const std::string& typeName) const {
    ScopedReadLock lock(this->projectLock());
    if (!name.empty()) options.key(name);
    if (writtenBare(name, typeName)) {
        ValueTraits<T>::write(options, indent, keyframes_.front().keyframe->value_);
        return;
    }
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    const std::string type = typeName.empty() ? parameterTypeString() : typeName;
    if (!type.empty()) {
        options.key("type");
        writeJSONValue(options, members, type);
    }
    const std::string interp = parameterInterpolaterName();
    if (!interp.empty()) {
        options.key("interp");
        writeJSONValue(options, members, interp);
    }
    const Extras* e = extras_.get();
    if (e && e->bounds) writeBounds(options, members, *e->bounds);
    if (e && e->hints) {
        options.key("uiHints");
        JSONWriter hints(options, members);
        options.key("userInterfaceType");
        writeJSONValue(options, hints.memberLevel(), e->hints->userInterfaceType);
        options.key("unitType");
        writeJSONValue(options, hints.memberLevel(), e->hints->unitType);
    }
    writeKeyFrames(options, members);
    if (e && e->metadata.get()) MetaDatable::toJSON(options, members, *e->metadata.get());
}

template <typename T>
void ParameterImpl<T>::writeBounds(XMLOptions& options, int indent, const ValueBounds<T>& bounds) {
    options.key("valueBounds");
    JSONWriter object(options, indent);
    options.key("minValue");
    ValueTraits<T>::write(options, object.memberLevel(), bounds.minValue);
    options.key("maxValue");
    ValueTraits<T>::write(options, object.memberLevel(), bounds.maxValue);
    options.key("defaultValue");
    ValueTraits<T>::write(options, object.memberLevel(), bounds.defaultValue);
}

template <typename T>
void ParameterImpl<T>::writeKeyFrames(XMLOptions& options, int indent) const {
    options.key("keyframes");
    JSONWriter array(options, indent, JSONWriter::Array);
    for (const auto& entry : keyframes_) {
        options.element();
        entry.keyframe->toJSON(options, array.memberLevel());
    }
}

template <typename T>
void ParameterImpl<T>::readFromJSON(const Json::Value& json) {
    readDocument(json, false);
}

template <typename T>
void ParameterImpl<T>::replaceFromJSON(const Json::Value& json) {
    readDocument(json, true);
}

template <typename T>
boost::shared_ptr<ParameterImpl<T>> ParameterImpl<T>::readScratch(const Json::Value& json,
                                                                  bool fromNoKeyFrames) const {
    const boost::shared_ptr<ParameterImpl> scratch = cloneImpl();
    if (fromNoKeyFrames) scratch->clearForReading();
    scratch->readInto(json);
    return scratch;
}

template <typename T>
void ParameterImpl<T>::readDocument(const Json::Value& json, bool fromNoKeyFrames) {
    const boost::shared_ptr<ParameterImpl> scratch = readScratch(json, fromNoKeyFrames);
    edit([&] { takeStateFrom(*scratch); });
}

// Kinds with state of their own read it into copies of their own kind, so a
// copy of the same dynamic type is one whose state this kind can take.
template <typename T>
bool ParameterImpl<T>::takeStateOf(ParameterInterface& copy) {
    if (typeid(copy) != typeid(*this)) return false;
    ScopedWriteLock lock(this->projectMutex());
    takeStateFrom(static_cast<ParameterImpl&>(copy));
    keyframesEdited();
    return true;
}

template <typename T>
void ParameterImpl<T>::clearForReading() {
    keyframes_.clear();
    if (Extras* e = extras_.get()) e->metadata.reset();
}

template <typename T>
void ParameterImpl<T>::readInto(const Json::Value& json) {
    if (!ParameterDocument::isParameterObject(json)) {
        setDefaultValue(ValueTraits<T>::read(json)); // a bare value is the only keyframe, at time 0
        return;
    }
    if (json.isMember("interp"))
        readParameterInterpolater(ParameterDocument::requiredString(json["interp"], "interp"));
    if (json.isMember("valueBounds")) {
        const Json::Value& bounds = json["valueBounds"];
        setValueBounds(ValueTraits<T>::read(bounds["minValue"]), ValueTraits<T>::read(bounds["maxValue"]),
                       ValueTraits<T>::read(bounds["defaultValue"]));
    }
    if (json.isMember("uiHints")) {
        const Json::Value& hints = json["uiHints"];
        setUIHints(ParameterDocument::requiredString(hints["userInterfaceType"], "userInterfaceType"),
                   ParameterDocument::requiredString(hints["unitType"], "unitType"));
    }
    readKeyFrames(json);
    if (json.isMember("metadata")) MetaDatable::readFromJSON(json, *metaDataPtr());
}

// A "keyframes" array is read into the curve there is: an entry at a
// keyframe's time replaces that keyframe's value, others add keyframes.
template <typename T>
void ParameterImpl<T>::readKeyFrames(const Json::Value& json) {
    const Json::Value& array = json["keyframes"];
    if (!array.isNull() && !array.isArray())
        throw ParserException("Invalid project json - \"keyframes\" is not an array");
    for (const Json::Value& keyframe : array) readKeyFrame(keyframe);
    // Read from nothing, a parameter object without keyframes would hold no value.
    if (keyframes_.empty())
        throw ParserException("Invalid project json - parameter " + identifier_ + " has no keyframe");
}

template <typename T>
void ParameterImpl<T>::readKeyFrame(const Json::Value& json) {
    if (!json.isObject() || !json.isMember("value"))
        throw ParserException("Invalid project json - a keyframe of " + identifier_ + " has no value");
    const RationalTime leadIn =
        json.isMember("duration") ? jsonValueAsRationalTime(json["duration"]) : RationalTime(0);
    if (!json.isMember("endTime") && !json.isMember("time"))
        throw ParserException("Invalid project json - a keyframe of " + identifier_ + " has no time");
    const RationalTime end = json.isMember("endTime") ? jsonValueAsRationalTime(json["endTime"])
                                                      : jsonValueAsRationalTime(json["time"]) + leadIn;
    const T value = ValueTraits<T>::read(json["value"]);
    InterpolaterPtr interpolater;
    if (json.isMember("interp"))
        interpolater =
            InterpolaterFactory<T>::byName(ParameterDocument::requiredString(json["interp"], "interp"));
    const KeyFramePtr keyframe = placeReadKeyFrame(end, value, leadIn);
    if (!keyframe) return;
    keyframe->interpolater_ = interpolater;
    MetaDatable::readFromJSON(json, *keyframe);
}

template <typename T>
typename ParameterImpl<T>::KeyFramePtr
ParameterImpl<T>::placeReadKeyFrame(const RationalTime& end, const T& value, const RationalTime& leadIn) {
    if (const KeyFramePtr existing = exactKeyFrame(end)) {
        existing->value_ = value;
        return existing;
    }
    addKeyFrame(end, value, leadIn);
    return exactKeyFrame(end);
}

namespace ParameterDocument {

/// Gives the metadata exactly the entries read, keeping the object (callers
/// may hold it).
inline void replaceEntries(MetaDatable& metadata, const std::map<std::string, std::string>& entries) {
    for (const std::string& key : metadata.metaDataKeys())
        if (!entries.count(key)) metadata.removeMetaData(key);
    for (const auto& entry : entries) metadata.addMetaData(entry.first, entry.second);
}

} // namespace ParameterDocument

template <typename T>
void ParameterImpl<T>::takeStateFrom(ParameterImpl& read) {
    keyframes_.swap(read.keyframes_);
    for (auto& entry : keyframes_) entry.keyframe->setMetaDataProjectMutex(this->projectMutex());
    const Extras* theirs = read.extras_.get();
    if (!theirs && !extras_.get()) return;
    Extras& mine = extras();
    mine.bounds = theirs ? theirs->bounds : boost::none;
    mine.hints = theirs ? theirs->hints : boost::none;
    const std::map<std::string, std::string> entries = read.generateMetaDataMap();
    if (MetaDatable* metadata = mine.metadata.get())
        ParameterDocument::replaceEntries(*metadata, entries);
    else if (!entries.empty())
        ParameterDocument::replaceEntries(this->metadata(), entries);
}

} // namespace VelaMediaLib
