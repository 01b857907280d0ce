#include <VelaMediaLib/document/format/ValueFormatter.h>

#include <VelaMediaLib/document/format/JSONReader.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <charconv>
#include <cmath>
#include <json/writer.h>
#include <limits>

namespace VelaMediaLib {
namespace {

[[noreturn]] void refuse(const char* expected, const Json::Value& json) {
    throw ParserException(std::string("Invalid project json - expected ") + expected + ": " +
                          compactJSON(json));
}

template <typename Number>
std::string shortest(Number value) {
    if (!std::isfinite(value)) return "null";
    char text[64];
    const std::to_chars_result result = std::to_chars(text, text + sizeof text, value);
    std::string written(text, result.ptr);
    if (written.find_first_of(".e") == std::string::npos) written += ".0"; // visibly a real number
    return written;
}

double number(const Json::Value& json) {
    if (json.isNull()) return std::numeric_limits<double>::quiet_NaN();
    if (!json.isNumeric()) refuse("a number", json);
    return json.asDouble();
}

// Arrays of numbers: [a, b, c].
template <size_t N>
void writeNumbers(std::ostream& out, const double (&values)[N]) {
    out << "[";
    for (size_t i = 0; i < N; ++i) out << (i ? ", " : "") << formatDouble(values[i]);
    out << "]";
}

const Json::Value& numbers(const Json::Value& json, unsigned count, const char* what) {
    if (!json.isArray() || json.size() != count) refuse(what, json);
    return json;
}

const Json::Value& member(const Json::Value& json, const char* key, const char* what) {
    if (!json.isObject()) refuse(what, json);
    return json[key];
}

std::string text(const Json::Value& json) {
    if (json.isNull()) return std::string();
    if (!json.isString()) refuse("a string", json);
    return json.asString();
}

} // namespace

std::string formatDouble(double value) { return shortest(value); }
std::string formatFloat(float value) { return shortest(value); }

std::string compactJSON(const Json::Value& value) {
    Json::StreamWriterBuilder builder;
    builder["indentation"] = "";
    return Json::writeString(builder, value);
}

void ValueFormatter<bool>::write(std::ostream& out, const bool& value) { out << (value ? "true" : "false"); }
bool ValueFormatter<bool>::read(const Json::Value& json) {
    if (!json.isBool()) refuse("a boolean", json);
    return json.asBool();
}

void ValueFormatter<int>::write(std::ostream& out, const int& value) { out << value; }
int ValueFormatter<int>::read(const Json::Value& json) {
    if (!json.isInt()) refuse("an integer", json);
    return json.asInt();
}

void ValueFormatter<long long>::write(std::ostream& out, const long long& value) { out << value; }
long long ValueFormatter<long long>::read(const Json::Value& json) {
    if (!json.isInt64()) refuse("a 64-bit integer", json);
    return json.asInt64();
}

void ValueFormatter<float>::write(std::ostream& out, const float& value) { out << formatFloat(value); }
float ValueFormatter<float>::read(const Json::Value& json) { return float(number(json)); }

void ValueFormatter<double>::write(std::ostream& out, const double& value) { out << formatDouble(value); }
double ValueFormatter<double>::read(const Json::Value& json) { return number(json); }

void ValueFormatter<std::string>::write(std::ostream& out, const std::string& value) {
    out << quotedJSONString(value);
}
std::string ValueFormatter<std::string>::read(const Json::Value& json) { return text(json); }

// Whole numbers as integers, others as "n/d".
void ValueFormatter<SafeRational>::write(std::ostream& out, const SafeRational& value) {
    if (value.denominator() == 1)
        out << value.numerator();
    else
        out << '"' << value << '"';
}
SafeRational ValueFormatter<SafeRational>::read(const Json::Value& json) {
    return JSONReader::jsonValueAsVelaRational(json);
}

void ValueFormatter<RationalTime>::write(std::ostream& out, const RationalTime& value) {
    ValueFormatter<SafeRational>::write(out, value.asRational());
}
RationalTime ValueFormatter<RationalTime>::read(const Json::Value& json) {
    return JSONReader::jsonValueAsRationalTime(json);
}

// A tick range as [start, duration].
void ValueFormatter<Range<long long>>::write(std::ostream& out, const Range<long long>& value) {
    out << "[" << value.first() << ", " << value.second() << "]";
}
Range<long long> ValueFormatter<Range<long long>>::read(const Json::Value& json) {
    numbers(json, 2, "a tick range [start, duration]");
    return Range<long long>(JSONReader::jsonValueAsVelaTime(json[0]),
                            JSONReader::jsonValueAsVelaTime(json[1]));
}

void ValueFormatter<Rect<float>>::write(std::ostream& out, const Rect<float>& r) {
    out << "[" << formatFloat(r.x) << ", " << formatFloat(r.y) << ", " << formatFloat(r.width) << ", "
        << formatFloat(r.height) << "]";
}
Rect<float> ValueFormatter<Rect<float>>::read(const Json::Value& json) {
    numbers(json, 4, "a rectangle [x, y, width, height]");
    return Rect<float>(float(number(json[0])), float(number(json[1])), float(number(json[2])),
                       float(number(json[3])));
}

void ValueFormatter<TemplatedColor<int>>::write(std::ostream& out, const TemplatedColor<int>& c) {
    out << "[" << c.red << ", " << c.green << ", " << c.blue << ", " << c.alpha << "]";
}
TemplatedColor<int> ValueFormatter<TemplatedColor<int>>::read(const Json::Value& json) {
    numbers(json, 4, "a colour [red, green, blue, alpha]");
    return TemplatedColor<int>(ValueFormatter<int>::read(json[0]), ValueFormatter<int>::read(json[1]),
                               ValueFormatter<int>::read(json[2]), ValueFormatter<int>::read(json[3]));
}

void ValueFormatter<Point3d>::write(std::ostream& out, const Point3d& p) {
    const double values[] = {p.x, p.y, p.z};
    writeNumbers(out, values);
}
Point3d ValueFormatter<Point3d>::read(const Json::Value& json) {
    numbers(json, 3, "a point [x, y, z]");
    return Point3d(number(json[0]), number(json[1]), number(json[2]));
}

void ValueFormatter<TransformMatrix>::write(std::ostream& out, const TransformMatrix& m) {
    double values[16];
    for (int i = 0; i < 16; ++i) values[i] = m.elements()[i];
    writeNumbers(out, values);
}
TransformMatrix ValueFormatter<TransformMatrix>::read(const Json::Value& json) {
    numbers(json, 16, "a matrix of 16 numbers");
    TransformMatrix::Elements elements;
    for (unsigned i = 0; i < 16; ++i) elements[i] = number(json[i]);
    return TransformMatrix(elements);
}

void ValueFormatter<AudioPosition>::write(std::ostream& out, const AudioPosition& p) {
    const double values[] = {p.pan, p.depth};
    writeNumbers(out, values);
}
AudioPosition ValueFormatter<AudioPosition>::read(const Json::Value& json) {
    numbers(json, 2, "an audio position [pan, depth]");
    return AudioPosition(number(json[0]), number(json[1]));
}

void ValueFormatter<CaptionData>::write(std::ostream& out, const CaptionData& c) {
    out << "{" << keyName("text") << quotedJSONString(c.text) << ", " << keyName("lang")
        << quotedJSONString(c.language) << "}";
}
CaptionData ValueFormatter<CaptionData>::read(const Json::Value& json) {
    const char* what = "caption data {\"text\", \"lang\"}";
    return CaptionData(text(member(json, "text", what)), text(member(json, "lang", what)));
}

void ValueFormatter<KeystrokeData>::write(std::ostream& out, const KeystrokeData& k) {
    out << "{" << keyName("key") << quotedJSONString(k.key) << ", " << keyName("modifiers") << k.modifiers
        << "}";
}
KeystrokeData ValueFormatter<KeystrokeData>::read(const Json::Value& json) {
    const char* what = "a keystroke {\"key\", \"modifiers\"}";
    const Json::Value& modifiers = member(json, "modifiers", what);
    return KeystrokeData(text(member(json, "key", what)),
                         modifiers.isNull() ? 0 : ValueFormatter<int>::read(modifiers));
}

void ValueFormatter<TextAttributeList>::write(std::ostream& out, const TextAttributeList& list) {
    out << "{" << keyName("text") << quotedJSONString(list.text()) << ", " << keyName("runs") << "[";
    bool first = true;
    for (const TextAttributeList::Run& run : list.runs()) {
        out << (first ? "" : ", ") << "{" << keyName("start") << run.start << ", " << keyName("length")
            << run.length << ", " << keyName("name") << quotedJSONString(run.name) << ", " << keyName("value")
            << quotedJSONString(run.value) << "}";
        first = false;
    }
    out << "]}";
}
TextAttributeList ValueFormatter<TextAttributeList>::read(const Json::Value& json) {
    const char* what = "attributed text {\"text\", \"runs\"}";
    TextAttributeList list(text(member(json, "text", what)));
    for (const Json::Value& run : member(json, "runs", what)) {
        if (!run.isObject() || !run["start"].isUInt64() || !run["length"].isUInt64())
            refuse("a text run", run);
        if (!list.addRun(size_t(run["start"].asUInt64()), size_t(run["length"].asUInt64()), text(run["name"]),
                         text(run["value"])))
            refuse("a text run inside the text", run);
    }
    return list;
}

void ValueFormatter<std::vector<double>>::write(std::ostream& out, const std::vector<double>& values) {
    out << "[";
    for (size_t i = 0; i < values.size(); ++i) out << (i ? ", " : "") << formatDouble(values[i]);
    out << "]";
}
std::vector<double> ValueFormatter<std::vector<double>>::read(const Json::Value& json) {
    if (!json.isArray()) refuse("an array of numbers", json);
    std::vector<double> values;
    for (const Json::Value& each : json) values.push_back(number(each));
    return values;
}

void ValueFormatter<std::list<Rect<float>>>::write(std::ostream& out, const std::list<Rect<float>>& rects) {
    out << "[";
    bool first = true;
    for (const Rect<float>& rect : rects) {
        out << (first ? "" : ", ");
        ValueFormatter<Rect<float>>::write(out, rect);
        first = false;
    }
    out << "]";
}
std::list<Rect<float>> ValueFormatter<std::list<Rect<float>>>::read(const Json::Value& json) {
    if (!json.isArray()) refuse("an array of rectangles", json);
    std::list<Rect<float>> rects;
    for (const Json::Value& each : json) rects.push_back(ValueFormatter<Rect<float>>::read(each));
    return rects;
}

} // namespace VelaMediaLib
