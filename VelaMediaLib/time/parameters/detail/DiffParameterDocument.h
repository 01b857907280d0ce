#pragma once
// DiffParameter: reading its document form, "edits", "deletions" and
// "ignoreSource". Only the library reads documents.

#include <VelaMediaLib/time/parameters/DiffParameter.h>
#include <VelaMediaLib/time/parameters/detail/ParameterImplDocument.h>

#include <json/value.h>

namespace VelaMediaLib {

template <typename T>
void DiffParameter<T>::readKeyFrames(const Json::Value& json) {
    KeyFrameMap edits;
    for (const Json::Value& entry : json["edits"]) {
        if (!entry.isObject() || !entry.isMember("time") || !entry.isMember("value"))
            throw ParserException("Invalid project json - an edit of " + this->identifier() +
                                  " needs a time and a value");
        const RationalTime time = jsonValueAsRationalTime(entry["time"]);
        const RationalTime leadIn =
            entry.isMember("duration") ? jsonValueAsRationalTime(entry["duration"]) : RationalTime(0);
        if (leadIn < RationalTime(0))
            throw ParserException("Invalid project json - an edit of " + this->identifier() +
                                  " has a negative duration");
        const typename Base::KeyFramePtr keyframe =
            this->newKeyFrame(time, ValueTraits<T>::read(entry["value"]), leadIn);
        if (entry.isMember("interp"))
            keyframe->setInterpolater(
                InterpolaterFactory<T>::byName(ParameterDocument::requiredString(entry["interp"], "interp")));
        MapUtil::put(edits, time, keyframe);
    }
    std::set<RationalTime> deletions;
    for (const Json::Value& time : json["deletions"]) deletions.insert(jsonValueAsRationalTime(time));
    edits_.swap(edits);
    deletions_.swap(deletions);
    ignoreSource_ = json["ignoreSource"].isBool() && json["ignoreSource"].asBool();
    rebuild();
}

} // namespace VelaMediaLib
