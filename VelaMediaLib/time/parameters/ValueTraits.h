#pragma once
// Everything the library knows of a value type that parameters and attributes
// hold, in one ValueTraits<T> per type:
// - typeName(): the type name written into documents;
// - similar(a, b): equal within the type's tolerance (a millionth relative
//   for float members, a billionth relative for double members; other
//   values compare exactly), and same(a, b): equal exactly;
// - interpolation: which interpolater kinds the type has, and with it
//   whether it tweens; a type that tweens has blend(a, b, w), always
//   w*b + (1 - w)*a, integer kinds rounding to the nearest whole value and
//   compound values blending member by member;
// - write(options, indent, value) and read(json): its document form.
//   Rectangles, colours, points, matrices and audio positions are flat arrays
//   of numbers; captions, keystrokes and attributed text are small objects on
//   one line.
// The parameter value types are listed once, at the end, for instantiation.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/AudioPosition.h>
#include <VelaMediaLib/base/CaptionData.h>
#include <VelaMediaLib/base/KeystrokeData.h>
#include <VelaMediaLib/base/Point3d.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/base/TextAttributeList.h>
#include <VelaMediaLib/base/TransformMatrix.h>
#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/time/interpolaters/Interpolater.h>

#include <algorithm>
#include <cmath>
#include <list>
#include <string>
#include <vector>

namespace VelaMediaLib {

/// How a value type may move between keyframes; each level has the kinds of
/// the levels before it.
enum class Interpolation {
    Step,   ///< only "left": the value jumps at the keyframe; no blend
    Eases,  ///< "linr", "esIn", "esOt": the type tweens
    Curves, ///< "eios", "eioe", "bnce", "sprg"
    Paths   ///< Bézier curves through space (positions)
};

template <typename T>
struct ValueTraits;

// Interpolater values are read through the factory, whose interpolaters
// blend through these traits; users of read() include InterpolaterFactory.h.
template <typename T>
class InterpolaterFactory;

namespace ValueTolerance {

inline bool close(double a, double b, double relative) {
    if (a == b) return true;
    return std::fabs(a - b) <= relative * std::max(1.0, std::max(std::fabs(a), std::fabs(b)));
}

} // namespace ValueTolerance

/// Values compared exactly, both for similarity and sameness.
template <typename T>
struct VELAMEDIALIB_TEMPLATE_API ExactValue {
    static bool similar(const T& a, const T& b) { return a == b; }
    static bool same(const T& a, const T& b) { return a == b; }
};

template <>
struct VELAMEDIALIB_API ValueTraits<bool> : ExactValue<bool> { // attributes only
    static const char* typeName() { return "bool"; }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& o, int indent, bool v) { writeJSONValue(o, indent, v); }
    static bool read(const Json::Value& json) { return jsonValueAsBool(json); }
};

template <>
struct VELAMEDIALIB_API ValueTraits<int> : ExactValue<int> {
    static const char* typeName() { return "int"; }
    static constexpr Interpolation interpolation = Interpolation::Curves;
    static int blend(int a, int b, double w) { return int(std::lround(w * b + (1.0 - w) * a)); }
    static void write(XMLOptions& o, int indent, int v) { writeJSONValue(o, indent, v); }
    static int read(const Json::Value& json) { return jsonValueAsInt(json); }
};

template <>
struct VELAMEDIALIB_API ValueTraits<long long> : ExactValue<long long> {
    static const char* typeName() { return "int64"; }
    static constexpr Interpolation interpolation = Interpolation::Eases;
    static long long blend(long long a, long long b, double w) {
        return std::llround(w * double(b) + (1.0 - w) * double(a));
    }
    static void write(XMLOptions& o, int indent, long long v) { writeJSONValue(o, indent, v); }
    static long long read(const Json::Value& json) { return jsonValueAsInt64(json); }
};

template <>
struct VELAMEDIALIB_API ValueTraits<float> {
    static const char* typeName() { return "?"; }
    static bool similar(float a, float b) { return ValueTolerance::close(a, b, 1e-6); }
    static bool same(float a, float b) { return a == b; }
    static constexpr Interpolation interpolation = Interpolation::Curves;
    static float blend(float a, float b, double w) { return float(w * b + (1.0 - w) * a); }
    static void write(XMLOptions& o, int indent, float v) { writeJSONValue(o, indent, v); }
    static float read(const Json::Value& json) { return jsonValueAsFloat(json); }
};

template <>
struct VELAMEDIALIB_API ValueTraits<double> {
    static const char* typeName() { return "double"; }
    static bool similar(double a, double b) { return ValueTolerance::close(a, b, 1e-9); }
    static bool same(double a, double b) { return a == b; }
    static constexpr Interpolation interpolation = Interpolation::Curves;
    static double blend(double a, double b, double w) { return w * b + (1.0 - w) * a; }
    static void write(XMLOptions& o, int indent, double v) { writeJSONValue(o, indent, v); }
    static double read(const Json::Value& json) { return jsonValueAsDouble(json); }
};

template <>
struct VELAMEDIALIB_API ValueTraits<std::string> : ExactValue<std::string> {
    static const char* typeName() { return "string"; }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& o, int indent, const std::string& v) { writeJSONValue(o, indent, v); }
    static std::string read(const Json::Value& json) { return jsonValueAsString(json); }
};

template <>
struct VELAMEDIALIB_API ValueTraits<SafeRational> : ExactValue<SafeRational> {
    static const char* typeName() { return "rational"; }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& o, int indent, const SafeRational& v) { writeJSONValue(o, indent, v); }
    static SafeRational read(const Json::Value& json) { return jsonValueAsVelaRational(json); }
};

template <>
struct VELAMEDIALIB_API ValueTraits<Rect<float>> {
    typedef ValueTraits<float> Member;
    static const char* typeName() { return "rect"; }
    static bool similar(const Rect<float>& a, const Rect<float>& b) {
        return Member::similar(a.x, b.x) && Member::similar(a.y, b.y) && Member::similar(a.width, b.width) &&
               Member::similar(a.height, b.height);
    }
    static bool same(const Rect<float>& a, const Rect<float>& b) { return a == b; }
    static constexpr Interpolation interpolation = Interpolation::Curves;
    static Rect<float> blend(const Rect<float>& a, const Rect<float>& b, double w) {
        return Rect<float>(Member::blend(a.x, b.x, w), Member::blend(a.y, b.y, w),
                           Member::blend(a.width, b.width, w), Member::blend(a.height, b.height, w));
    }
    static void write(XMLOptions& options, int indent, const Rect<float>& value);
    static Rect<float> read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<TemplatedColor<int>> : ExactValue<TemplatedColor<int>> {
    typedef ValueTraits<int> Member;
    static const char* typeName() { return "color"; }
    static constexpr Interpolation interpolation = Interpolation::Curves;
    static TemplatedColor<int> blend(const TemplatedColor<int>& a, const TemplatedColor<int>& b, double w) {
        return TemplatedColor<int>(Member::blend(a.red, b.red, w), Member::blend(a.green, b.green, w),
                                   Member::blend(a.blue, b.blue, w), Member::blend(a.alpha, b.alpha, w));
    }
    static void write(XMLOptions& options, int indent, const TemplatedColor<int>& value);
    static TemplatedColor<int> read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<Point3d> {
    typedef ValueTraits<double> Member;
    static const char* typeName() { return "point"; }
    static bool similar(const Point3d& a, const Point3d& b) {
        return Member::similar(a.x, b.x) && Member::similar(a.y, b.y) && Member::similar(a.z, b.z);
    }
    static bool same(const Point3d& a, const Point3d& b) { return a == b; }
    static constexpr Interpolation interpolation = Interpolation::Paths;
    static Point3d blend(const Point3d& a, const Point3d& b, double w) {
        return Point3d(Member::blend(a.x, b.x, w), Member::blend(a.y, b.y, w), Member::blend(a.z, b.z, w));
    }
    static void write(XMLOptions& options, int indent, const Point3d& value);
    static Point3d read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<AudioPosition> {
    typedef ValueTraits<double> Member;
    static const char* typeName() { return "audioPosition"; }
    static bool similar(const AudioPosition& a, const AudioPosition& b) {
        return Member::similar(a.pan, b.pan) && Member::similar(a.depth, b.depth);
    }
    static bool same(const AudioPosition& a, const AudioPosition& b) { return a == b; }
    static constexpr Interpolation interpolation = Interpolation::Eases;
    static AudioPosition blend(const AudioPosition& a, const AudioPosition& b, double w) {
        return AudioPosition(Member::blend(a.pan, b.pan, w), Member::blend(a.depth, b.depth, w));
    }
    static void write(XMLOptions& options, int indent, const AudioPosition& value);
    static AudioPosition read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<TransformMatrix> {
    typedef ValueTraits<double> Member;
    static const char* typeName() { return "matrix"; }
    static bool similar(const TransformMatrix& a, const TransformMatrix& b) {
        for (size_t i = 0; i < a.elements().size(); ++i)
            if (!Member::similar(a.elements()[i], b.elements()[i])) return false;
        return true;
    }
    static bool same(const TransformMatrix& a, const TransformMatrix& b) { return a == b; }
    static constexpr Interpolation interpolation = Interpolation::Eases;
    static TransformMatrix blend(const TransformMatrix& a, const TransformMatrix& b, double w) {
        TransformMatrix::Elements elements;
        for (size_t i = 0; i < elements.size(); ++i)
            elements[i] = Member::blend(a.elements()[i], b.elements()[i], w);
        return TransformMatrix(elements);
    }
    static void write(XMLOptions& options, int indent, const TransformMatrix& value);
    static TransformMatrix read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<CaptionData> : ExactValue<CaptionData> {
    static const char* typeName() { return "caption"; }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& options, int indent, const CaptionData& value);
    static CaptionData read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<KeystrokeData> : ExactValue<KeystrokeData> {
    static const char* typeName() { return "keystroke"; }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& options, int indent, const KeystrokeData& value);
    static KeystrokeData read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<TextAttributeList> : ExactValue<TextAttributeList> {
    static const char* typeName() { return "textAttributeList"; }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& options, int indent, const TextAttributeList& value);
    static TextAttributeList read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<std::vector<double>> {
    typedef ValueTraits<double> Member;
    static const char* typeName() { return "vector"; }
    static bool similar(const std::vector<double>& a, const std::vector<double>& b) {
        return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), Member::similar);
    }
    static bool same(const std::vector<double>& a, const std::vector<double>& b) { return a == b; }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& options, int indent, const std::vector<double>& value);
    static std::vector<double> read(const Json::Value& json);
};

template <>
struct VELAMEDIALIB_API ValueTraits<std::list<Rect<float>>> {
    typedef ValueTraits<Rect<float>> Member;
    static const char* typeName() { return "rectList"; }
    static bool similar(const std::list<Rect<float>>& a, const std::list<Rect<float>>& b) {
        return a.size() == b.size() && std::equal(a.begin(), a.end(), b.begin(), Member::similar);
    }
    static bool same(const std::list<Rect<float>>& a, const std::list<Rect<float>>& b) { return a == b; }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& options, int indent, const std::list<Rect<float>>& value);
    static std::list<Rect<float>> read(const Json::Value& json);
};

/// Parameters whose value is itself an interpolater. Two are the same when
/// their document forms are (a Bézier read back is a new instance of the same
/// curve); one is written as its name and read back through the shared
/// instances; an empty reference is written as null.
template <typename X>
struct VELAMEDIALIB_TEMPLATE_API ValueTraits<boost::shared_ptr<Interpolater<X>>> {
    typedef boost::shared_ptr<Interpolater<X>> Pointer;
    static const char* typeName() { return "interpolater"; }
    static bool same(const Pointer& a, const Pointer& b) {
        if (!a || !b) return a == b;
        return a == b || a->asJson() == b->asJson();
    }
    static bool similar(const Pointer& a, const Pointer& b) { return same(a, b); }
    static constexpr Interpolation interpolation = Interpolation::Step;
    static void write(XMLOptions& options, int, const Pointer& value) {
        options.stream() << (value ? value->asJson() : std::string("null"));
    }
    static Pointer read(const Json::Value& json) {
        if (jsonValueIsNull(json)) return Pointer();
        return InterpolaterFactory<X>::byName(jsonValueAsString(json));
    }
};

} // namespace VelaMediaLib

/// The value types parameters exist for: ParameterImpl is built once in the
/// library for each (every one needs a ValueTraits above).
#define VELA_FOR_EACH_PARAMETER_VALUE_TYPE(X)                                                                \
    X(int)                                                                                                   \
    X(float)                                                                                                 \
    X(double)                                                                                                \
    X(long long)                                                                                             \
    X(std::string)                                                                                           \
    X(::VelaMediaLib::Rect<float>)                                                                           \
    X(::VelaMediaLib::TemplatedColor<int>)                                                                   \
    X(std::list<::VelaMediaLib::Rect<float>>)                                                                \
    X(::VelaMediaLib::AudioPosition)                                                                         \
    X(::VelaMediaLib::CaptionData)                                                                           \
    X(::VelaMediaLib::KeystrokeData)                                                                         \
    X(::VelaMediaLib::Point3d)                                                                               \
    X(::VelaMediaLib::SafeRational)                                                                          \
    X(::VelaMediaLib::TextAttributeList)                                                                     \
    X(::VelaMediaLib::TransformMatrix)                                                                       \
    X(std::vector<double>)                                                                                   \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<int>>)                                                  \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<float>>)                                                \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<double>>)                                               \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<::VelaMediaLib::Rect<float>>>)                          \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<::VelaMediaLib::TemplatedColor<int>>>)                  \
    X(boost::shared_ptr<::VelaMediaLib::Interpolater<::VelaMediaLib::Point3d>>)
