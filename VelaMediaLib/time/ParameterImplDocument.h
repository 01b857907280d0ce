#pragma once
// ParameterImpl: the document form. A parameter is written bare (its value
// alone) or as an object with "type", "interp", "valueBounds", "uiHints" and
// "keyframes", each where it applies. Reading goes into a scratch copy that
// takes this parameter's place only when the whole value was read.

#include <VelaMediaLib/document/JSONReader.h>
#include <VelaMediaLib/document/JSONWriter.h>

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
    if (keyframes_.size() != 1 || extras_) return false; // bounds, hints and metadata need the object form
    const std::string interp = parameterInterpolaterName();
    if (!interp.empty() && interp != InterpolaterFactory<T>::defaultInterpolater()->name()) return false;
    const KeyFrame<T>& only = *keyframes_.front().keyframe;
    return keyframes_.front().time == RationalTime(0) && only.leadIn_ == RationalTime(0) &&
           !only.interpolater_ && only.metaDataKeys().empty();
}

template <typename T>
void ParameterImpl<T>::toJSON(XMLOptions& options, int indent, const std::string& name,
                              const std::string& typeName) const {
    ScopedReadLock lock(this->projectMutex());
    if (!name.empty()) options.stream() << keyName(name);
    if (writtenBare(name, typeName)) {
        ValueFormatter<T>::write(options.stream(), keyframes_.front().keyframe->value_);
        return;
    }
    JSONWriter object(options, indent);
    const std::string type = typeName.empty() ? parameterTypeString() : typeName;
    if (!type.empty()) object.key("type") << quotedJSONString(type);
    const std::string interp = parameterInterpolaterName();
    if (!interp.empty()) object.key("interp") << quotedJSONString(interp);
    if (extras_ && extras_->bounds) {
        object.key("valueBounds");
        JSONWriter bounds(options, object.memberLevel());
        ValueFormatter<T>::write(bounds.key("minValue"), extras_->bounds->minValue);
        ValueFormatter<T>::write(bounds.key("maxValue"), extras_->bounds->maxValue);
        ValueFormatter<T>::write(bounds.key("defaultValue"), extras_->bounds->defaultValue);
    }
    if (extras_ && extras_->hints) {
        object.key("uiHints");
        JSONWriter hints(options, object.memberLevel());
        hints.key("userInterfaceType") << quotedJSONString(extras_->hints->userInterfaceType);
        hints.key("unitType") << quotedJSONString(extras_->hints->unitType);
    }
    writeKeyFrames(object);
    if (extras_ && extras_->metadata) MetaDatable::toJSON(object, *extras_->metadata);
}

template <typename T>
void ParameterImpl<T>::writeKeyFrames(JSONWriter& object) const {
    object.key("keyframes");
    JSONWriter array(object.options(), object.memberLevel(), JSONWriter::Array);
    for (const auto& entry : keyframes_) {
        array.element();
        entry.keyframe->toJSON(object.options(), array.memberLevel());
    }
}

template <typename T>
void ParameterImpl<T>::readFromJSON(const Json::Value& json) {
    const boost::shared_ptr<ParameterImpl> scratch = cloneImpl();
    scratch->readInto(json);
    edit([&] { takeStateFrom(*scratch); });
}

template <typename T>
void ParameterImpl<T>::readInto(const Json::Value& json) {
    if (!ParameterDocument::isParameterObject(json)) {
        setDefaultValue(ValueFormatter<T>::read(json)); // a bare value is the only keyframe, at time 0
        return;
    }
    if (json.isMember("interp"))
        readParameterInterpolater(ParameterDocument::requiredString(json["interp"], "interp"));
    if (json.isMember("valueBounds")) {
        const Json::Value& bounds = json["valueBounds"];
        setValueBounds(ValueFormatter<T>::read(bounds["minValue"]),
                       ValueFormatter<T>::read(bounds["maxValue"]),
                       ValueFormatter<T>::read(bounds["defaultValue"]));
    }
    if (json.isMember("uiHints")) {
        const Json::Value& hints = json["uiHints"];
        setUIHints(ParameterDocument::requiredString(hints["userInterfaceType"], "userInterfaceType"),
                   ParameterDocument::requiredString(hints["unitType"], "unitType"));
    }
    readKeyFrames(json);
    if (json.isMember("metadata")) JSONReader::readMetaData(json, *metaDataPtr());
}

// A "keyframes" array replaces the curve: reading starts from no keyframes,
// and a later entry at the same end time replaces the value of an earlier one.
template <typename T>
void ParameterImpl<T>::readKeyFrames(const Json::Value& json) {
    const Json::Value& array = json["keyframes"];
    if (array.isNull()) return;
    if (!array.isArray()) throw ParserException("Invalid project json - \"keyframes\" is not an array");
    keyframes_.clear();
    for (const Json::Value& keyframe : array) readKeyFrame(keyframe);
    if (keyframes_.empty())
        throw ParserException("Invalid project json - parameter " + identifier_ + " has no keyframe");
}

template <typename T>
void ParameterImpl<T>::readKeyFrame(const Json::Value& json) {
    if (!json.isObject() || !json.isMember("value"))
        throw ParserException("Invalid project json - a keyframe of " + identifier_ + " has no value");
    const RationalTime leadIn =
        json.isMember("duration") ? JSONReader::jsonValueAsRationalTime(json["duration"]) : RationalTime(0);
    if (!json.isMember("endTime") && !json.isMember("time"))
        throw ParserException("Invalid project json - a keyframe of " + identifier_ + " has no time");
    const RationalTime end = json.isMember("endTime")
                                 ? JSONReader::jsonValueAsRationalTime(json["endTime"])
                                 : JSONReader::jsonValueAsRationalTime(json["time"]) + leadIn;
    const T value = ValueFormatter<T>::read(json["value"]);
    InterpolaterPtr interpolater;
    if (json.isMember("interp"))
        interpolater =
            InterpolaterFactory<T>::byName(ParameterDocument::requiredString(json["interp"], "interp"));
    const KeyFramePtr keyframe = placeReadKeyFrame(end, value, leadIn);
    if (!keyframe) return;
    keyframe->interpolater_ = interpolater;
    JSONReader::readMetaData(json, *keyframe);
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

template <typename T>
void ParameterImpl<T>::takeStateFrom(ParameterImpl& read) {
    keyframes_.swap(read.keyframes_);
    for (auto& entry : keyframes_) entry.keyframe->setMetaDataProjectMutex(this->projectMutex());
    if (!read.extras_ && !extras_) return;
    Extras& mine = extras();
    mine.bounds = read.extras_ ? read.extras_->bounds : boost::none;
    mine.hints = read.extras_ ? read.extras_->hints : boost::none;
    mine.metadata.reset(read.extras_ ? read.extras_->metadata.release() : nullptr);
}

} // namespace VelaMediaLib
