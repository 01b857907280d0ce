#pragma once
// Typed value formatters: how each value type that a parameter can hold is
// written into the document and read back. Scalars are JSON scalars;
// rectangles, colours, points, matrices and audio positions are flat arrays
// of numbers; captions, keystrokes and attributed text are small objects
// written on one line. Doubles are written in their shortest form that reads
// back as the same double; a value that is not finite is written as null and
// read back as NaN.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/AudioPosition.h>
#include <VelaMediaLib/base/CaptionData.h>
#include <VelaMediaLib/base/KeystrokeData.h>
#include <VelaMediaLib/base/Point3d.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/base/TextAttributeList.h>
#include <VelaMediaLib/base/TransformMatrix.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

#include <list>
#include <ostream>
#include <string>
#include <vector>

// Documents are read from jsoncpp values; only the library needs their definition.
namespace Json {
class Value;
} // namespace Json

namespace VelaMediaLib {

template <typename T>
struct ValueFormatter; // write(std::ostream&, const T&) and read(const Json::Value&)

VELAMEDIALIB_API std::string formatDouble(double value);
VELAMEDIALIB_API std::string formatFloat(float value);
/// The value on one line, for messages.
VELAMEDIALIB_API std::string compactJSON(const Json::Value& value);

#define VELA_VALUE_FORMATTER(Type)                                                                           \
    template <>                                                                                              \
    struct VELAMEDIALIB_API ValueFormatter<Type> {                                                           \
        static void write(std::ostream& out, const Type& value);                                             \
        static Type read(const Json::Value& json);                                                           \
    }

VELA_VALUE_FORMATTER(bool);
VELA_VALUE_FORMATTER(int);
VELA_VALUE_FORMATTER(long long);
VELA_VALUE_FORMATTER(float);
VELA_VALUE_FORMATTER(double);
VELA_VALUE_FORMATTER(std::string);
VELA_VALUE_FORMATTER(SafeRational);
VELA_VALUE_FORMATTER(RationalTime);
VELA_VALUE_FORMATTER(Range<long long>);
VELA_VALUE_FORMATTER(Rect<float>);
VELA_VALUE_FORMATTER(TemplatedColor<int>);
VELA_VALUE_FORMATTER(Point3d);
VELA_VALUE_FORMATTER(TransformMatrix);
VELA_VALUE_FORMATTER(AudioPosition);
VELA_VALUE_FORMATTER(CaptionData);
VELA_VALUE_FORMATTER(KeystrokeData);
VELA_VALUE_FORMATTER(TextAttributeList);
VELA_VALUE_FORMATTER(std::vector<double>);
VELA_VALUE_FORMATTER(std::list<Rect<float>>);

#undef VELA_VALUE_FORMATTER

} // namespace VelaMediaLib
