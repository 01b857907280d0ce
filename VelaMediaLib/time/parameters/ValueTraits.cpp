#include <VelaMediaLib/time/parameters/ValueTraits.h>

#include <VelaMediaLib/document/format/JSONWriter.h>

#include <ostream>
#include <json/value.h>

namespace VelaMediaLib {

#define VELA_CHECK_VALUE_TRAITS(Type)                                                                        \
    static_assert(sizeof(ValueTraits<Type>) > 0, "every parameter value type has its ValueTraits");
VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_CHECK_VALUE_TRAITS)
#undef VELA_CHECK_VALUE_TRAITS

namespace {

// Arrays of numbers: [a, b, c].
template <typename Numbers>
void writeNumbers(XMLOptions& options, const Numbers& values) {
    std::ostream& out = options.stream();
    const char* separator = "[";
    for (const double value : values) {
        out << separator << formatDouble(value);
        separator = options.inlineSeparator();
    }
    out << "]";
}

} // namespace

void ValueTraits<Rect<float>>::write(XMLOptions& options, int, const Rect<float>& r) {
    options.stream() << "[" << formatFloat(r.x) << options.inlineSeparator() << formatFloat(r.y)
                     << options.inlineSeparator() << formatFloat(r.width) << options.inlineSeparator()
                     << formatFloat(r.height) << "]";
}
Rect<float> ValueTraits<Rect<float>>::read(const Json::Value& json) {
    jsonArrayOf(json, 4, "a rectangle [x, y, width, height]");
    return Rect<float>(jsonValueAsFloat(json[0]), jsonValueAsFloat(json[1]), jsonValueAsFloat(json[2]),
                       jsonValueAsFloat(json[3]));
}

void ValueTraits<TemplatedColor<int>>::write(XMLOptions& options, int, const TemplatedColor<int>& c) {
    options.stream() << "[" << c.red << options.inlineSeparator() << c.green << options.inlineSeparator()
                     << c.blue << options.inlineSeparator() << c.alpha << "]";
}
TemplatedColor<int> ValueTraits<TemplatedColor<int>>::read(const Json::Value& json) {
    jsonArrayOf(json, 4, "a colour [red, green, blue, alpha]");
    return TemplatedColor<int>(jsonValueAsInt(json[0]), jsonValueAsInt(json[1]), jsonValueAsInt(json[2]),
                               jsonValueAsInt(json[3]));
}

void ValueTraits<Point3d>::write(XMLOptions& options, int, const Point3d& p) {
    const double values[] = {p.x, p.y, p.z};
    writeNumbers(options, values);
}
Point3d ValueTraits<Point3d>::read(const Json::Value& json) {
    jsonArrayOf(json, 3, "a point [x, y, z]");
    return Point3d(jsonValueAsDouble(json[0]), jsonValueAsDouble(json[1]), jsonValueAsDouble(json[2]));
}

void ValueTraits<TransformMatrix>::write(XMLOptions& options, int, const TransformMatrix& m) {
    writeNumbers(options, m.elements());
}
TransformMatrix ValueTraits<TransformMatrix>::read(const Json::Value& json) {
    jsonArrayOf(json, 16, "a matrix of 16 numbers");
    TransformMatrix::Elements elements;
    for (unsigned i = 0; i < 16; ++i) elements[i] = jsonValueAsDouble(json[i]);
    return TransformMatrix(elements);
}

void ValueTraits<AudioPosition>::write(XMLOptions& options, int, const AudioPosition& p) {
    const double values[] = {p.pan, p.depth};
    writeNumbers(options, values);
}
AudioPosition ValueTraits<AudioPosition>::read(const Json::Value& json) {
    jsonArrayOf(json, 2, "an audio position [pan, depth]");
    return AudioPosition(jsonValueAsDouble(json[0]), jsonValueAsDouble(json[1]));
}

void ValueTraits<CaptionData>::write(XMLOptions& options, int, const CaptionData& c) {
    options.stream() << "{" << options.inlineKey("text") << quotedJSONString(c.text)
                     << options.inlineSeparator() << options.inlineKey("lang") << quotedJSONString(c.language)
                     << "}";
}
CaptionData ValueTraits<CaptionData>::read(const Json::Value& json) {
    const char* what = "caption data {\"text\", \"lang\"}";
    return CaptionData(jsonValueAsString(jsonMemberOf(json, "text", what)),
                       jsonValueAsString(jsonMemberOf(json, "lang", what)));
}

void ValueTraits<KeystrokeData>::write(XMLOptions& options, int, const KeystrokeData& k) {
    options.stream() << "{" << options.inlineKey("key") << quotedJSONString(k.key)
                     << options.inlineSeparator() << options.inlineKey("modifiers") << k.modifiers << "}";
}
KeystrokeData ValueTraits<KeystrokeData>::read(const Json::Value& json) {
    const char* what = "a keystroke {\"key\", \"modifiers\"}";
    const Json::Value& modifiers = jsonMemberOf(json, "modifiers", what);
    return KeystrokeData(jsonValueAsString(jsonMemberOf(json, "key", what)),
                         modifiers.isNull() ? 0 : jsonValueAsInt(modifiers));
}

void ValueTraits<TextAttributeList>::write(XMLOptions& options, int, const TextAttributeList& list) {
    std::ostream& out = options.stream();
    out << "{" << options.inlineKey("text") << quotedJSONString(list.text()) << options.inlineSeparator()
        << options.inlineKey("runs") << "[";
    bool first = true;
    for (const TextAttributeList::Run& run : list.runs()) {
        out << (first ? "" : options.inlineSeparator()) << "{" << options.inlineKey("start") << run.start
            << options.inlineSeparator() << options.inlineKey("length") << run.length
            << options.inlineSeparator() << options.inlineKey("name") << quotedJSONString(run.name)
            << options.inlineSeparator() << options.inlineKey("value") << quotedJSONString(run.value) << "}";
        first = false;
    }
    out << "]}";
}
TextAttributeList ValueTraits<TextAttributeList>::read(const Json::Value& json) {
    const char* what = "attributed text {\"text\", \"runs\"}";
    TextAttributeList list(jsonValueAsString(jsonMemberOf(json, "text", what)));
    for (const Json::Value& run : jsonMemberOf(json, "runs", what)) {
        if (!run.isObject() || !run["start"].isUInt64() || !run["length"].isUInt64())
            refuseJSONValue("a text run", run);
        if (!list.addRun(size_t(run["start"].asUInt64()), size_t(run["length"].asUInt64()),
                         jsonValueAsString(run["name"]), jsonValueAsString(run["value"])))
            refuseJSONValue("a text run inside the text", run);
    }
    return list;
}

void ValueTraits<std::vector<double>>::write(XMLOptions& options, int, const std::vector<double>& values) {
    std::ostream& out = options.stream();
    out << "[";
    for (size_t i = 0; i < values.size(); ++i)
        out << (i ? options.inlineSeparator() : "") << formatDouble(values[i]);
    out << "]";
}
std::vector<double> ValueTraits<std::vector<double>>::read(const Json::Value& json) {
    if (!json.isArray()) refuseJSONValue("an array of numbers", json);
    std::vector<double> values;
    for (const Json::Value& each : json) values.push_back(jsonValueAsDouble(each));
    return values;
}

void ValueTraits<std::list<Rect<float>>>::write(XMLOptions& options, int indent,
                                                const std::list<Rect<float>>& rects) {
    options.stream() << "[";
    bool first = true;
    for (const Rect<float>& rect : rects) {
        options.stream() << (first ? "" : options.inlineSeparator());
        Member::write(options, indent, rect);
        first = false;
    }
    options.stream() << "]";
}
std::list<Rect<float>> ValueTraits<std::list<Rect<float>>>::read(const Json::Value& json) {
    if (!json.isArray()) refuseJSONValue("an array of rectangles", json);
    std::list<Rect<float>> rects;
    for (const Json::Value& each : json) rects.push_back(Member::read(each));
    return rects;
}

} // namespace VelaMediaLib
