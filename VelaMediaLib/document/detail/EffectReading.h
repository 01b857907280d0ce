#pragma once
// Effects are kept whole as the document gives them (see StoredEffect).

#include <json/value.h>

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class Effect;
class Effectable;

/// An effect object: "_type", "effectName", "category", "bypassed", "start",
/// "duration", "in", "center", "out", "parameters", "metadata" (others dropped).
boost::shared_ptr<Effect> readEffect(const Json::Value& value);
/// Each entry of the "effects" array, added in order.
void readEffects(const Json::Value& effects, Effectable& target);

} // namespace VelaMediaLib
