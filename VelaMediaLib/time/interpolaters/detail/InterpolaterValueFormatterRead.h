#pragma once
// Reading an interpolater value from a document: only the library reads
// documents, so only it needs jsoncpp's definitions.

#include <VelaMediaLib/time/interpolaters/InterpolaterValueFormatter.h>

#include <json/value.h>

namespace VelaMediaLib {

template <typename X>
boost::shared_ptr<Interpolater<X>>
ValueFormatter<boost::shared_ptr<Interpolater<X>>>::read(const Json::Value& json) {
    if (json.isNull()) return boost::shared_ptr<Interpolater<X>>();
    return InterpolaterFactory<X>::byName(ValueFormatter<std::string>::read(json));
}

} // namespace VelaMediaLib
