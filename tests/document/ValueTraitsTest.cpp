#include "../JsonTestSupport.h"

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/document/JSONReader.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <cmath>
#include <gtest/gtest.h>
#include <limits>
#include <random>
#include <set>
#include <sstream>

using namespace VelaMediaLib;
using VelaMediaLib::testing::parseJson;
using VelaMediaLib::testing::thrown;

namespace {

template <typename T>
std::string text(const T& value) {
    std::ostringstream out;
    XMLOptions options(out);
    ValueTraits<T>::write(options, 0, value);
    return out.str();
}

template <typename T>
T readBack(const T& value) {
    return ValueTraits<T>::read(parseJson(text(value)));
}

// Document texts of values of each type that parameters hold, the first unlike the type's default.
using Texts = std::vector<std::string>;
Texts samples(int*) { return {"-7", "3"}; }
Texts samples(float*) { return {"0.1", "3.4028235e+38"}; }
Texts samples(double*) { return {"0.3333333333333333", "0.1"}; }
Texts samples(long long*) { return {"9007199254740993", "-1"}; } // not a double
Texts samples(std::string*) { return {R"("a \"quoted\"\tline\n")", "\"\\\\ and \xc3\xa9\""}; }
Texts samples(Rect<float>*) { return {"[0.5, -1.0, 0.001, 2.0]", "[0.0, 0.0, 1920.0, 1080.0]"}; }
Texts samples(TemplatedColor<int>*) { return {"[1, 2, 3, 4]", "[255, 0, 0, 255]"}; }
Texts samples(std::list<Rect<float>>*) { return {"[[1.0, 2.0, 3.0, 4.0], [0.0, 0.0, 0.0, 0.0]]", "[]"}; }
Texts samples(AudioPosition*) { return {"[-0.25, 0.5]", "[-1.0, 0.0]"}; }
Texts samples(CaptionData*) {
    return {R"({"text" : "hello", "lang" : "en"})", R"({"text" : "Bonjour\n", "lang" : "fr-CA"})"};
}
Texts samples(KeystrokeData*) {
    return {R"({"key" : "K", "modifiers" : 5})", R"({"key" : "S", "modifiers" : 8})",
            R"({"key" : "Tab", "modifiers" : 0})"};
}
Texts samples(Point3d*) { return {"[1e-20, -2.0, 3.5]", "[1e-300, 2.0, 3.0]", "[-0.0, 1e+300, 5.0]"}; }
Texts samples(SafeRational*) { return {"\"-7/3\"", "\"1/3\"", "-5"}; }
Texts samples(TextAttributeList*) {
    return {
        R"({"textAttributeList" : {"text" : "bold words", "runs" : [{"start" : 0, "length" : 4, "name" : "fontWeight", "value" : "bold"}]}})",
        R"({"textAttributeList" : {"text" : "plain", "runs" : []}})"};
}
Texts samples(TransformMatrix*) {
    return {
        "[0.5, -1.0, 0.0, 1e-20, 2.0, 3.0, 0.14285714285714285, 0.0, 0.0, 0.0, 1.0, 0.0, 7.0, 0.0, 0.0, 1.0]",
        "[1.0, 0.0, 0.0, 0.0, 0.0, 1.0, 0.0, 0.0, 0.0, 0.0, 1.0, 0.0, 0.0, 0.0, 0.0, 1.0]"};
}
Texts samples(std::vector<double>*) { return {"[0.1, -1e+300, 4.0]", "[]"}; }
template <typename X>
Texts samples(boost::shared_ptr<Interpolater<X>>*) {
    return {"\"esIn\"", "\"left\""};
}
Texts samples(boost::shared_ptr<Interpolater<double>>*) { return {"\"linr\"", "\"bnce\""}; }
Texts samples(boost::shared_ptr<Interpolater<Point3d>>*) {
    return {"\"sprg\"", "\"bezr(esOt;1.0,2.0,3.0;0.0,0.0,0.0)\""};
}

const boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();

// A parameter read from its own document equals it: bare, then with keyframes of the later values.
template <typename Kind, typename T>
void expectParameterReadsBack(const boost::shared_ptr<Kind>& parameter, const std::vector<T>& later) {
    for (size_t i = 0; i <= later.size(); ++i) {
        if (i > 0) parameter->addKeyFrame(RationalTime(7 * i, 3), later[i - 1], RationalTime(1, 3));
        std::ostringstream out;
        XMLOptions options(out);
        parameter->toJSON(options, 1, "p");
        auto copy = parameter->clone();
        copy->setDefaultValue(later.back()); // differs before reading
        copy->readFromJSON(parseJson("{" + out.str() + "}")["p"]);
        EXPECT_TRUE(*copy == *parameter) << out.str();
    }
}

// Each sample reads into a value written back byte for byte, which reads back the same.
template <typename T>
void expectReadBack() {
    std::vector<T> values;
    for (const std::string& json : samples(static_cast<T*>(nullptr))) {
        values.push_back(ValueTraits<T>::read(parseJson(json)));
        EXPECT_EQ(text(values.back()), json) << ValueTraits<T>::typeName();
        const T again = readBack(values.back());
        EXPECT_TRUE(ValueTraits<T>::same(again, values.back())) << json;
        EXPECT_TRUE(ValueTraits<T>::similar(again, values.back())) << json;
    }
    expectParameterReadsBack(ParameterImpl<T>::create(project, "p", values[0]),
                             std::vector<T>(values.begin() + 1, values.end()));
}

} // namespace

TEST(ValueTraits, DoublesReadBackAsTheSameDouble) {
    std::mt19937_64 random(7);
    std::uniform_real_distribution<double> spread(-1e6, 1e6);
    for (int i = 0; i < 2000; ++i) {
        const double value = spread(random) * std::pow(10.0, double(i % 40) - 20.0);
        EXPECT_EQ(readBack(value), value) << text(value);
    }
    EXPECT_EQ(text(1.0), "1.0");
    EXPECT_EQ(text(0.1), "0.1");
    EXPECT_EQ(text(std::numeric_limits<double>::infinity()), "null");
    EXPECT_TRUE(std::isnan(ValueTraits<double>::read(parseJson("null"))));
}

TEST(ValueTraits, StringsAreEscapedAsJSONRequires) {
    const std::string awkward = std::string("a\"b\\c\n\t\x01 \xe2\x82\xac", 12);
    EXPECT_EQ(text(awkward), "\"a\\\"b\\\\c\\n\\t\\u0001 \xe2\x82\xac\"");
    EXPECT_EQ(readBack(awkward), awkward);
}

TEST(ValueTraits, RationalsAndTicks) {
    const auto rational = [](const char* json) {
        return JSONReader::jsonValueAsVelaRational(parseJson(json));
    };
    EXPECT_EQ(text(SafeRational(60000, 1001)), "\"60000/1001\"");
    EXPECT_EQ(text(SafeRational(30)), "30");
    EXPECT_EQ(rational("\"60000/1001\""), SafeRational(60000, 1001));
    EXPECT_EQ(rational("30"), SafeRational(30));
    EXPECT_EQ(thrown<ParserException>([&] { rational("1.5"); }),
              "Invalid project json - unsupported json type for VelaRational: 1.5");
    EXPECT_THROW(rational("\"1/x\""), std::invalid_argument);
    EXPECT_THROW(rational("\"99999999999999999999/1\""), std::out_of_range);
    EXPECT_THROW(rational("\"1/0\""), boost::bad_rational);
    std::ostringstream ticks;
    XMLOptions options(ticks);
    writeJSONValue(options, 0, Range<long long>(10, 25));
    EXPECT_EQ(ticks.str(), "[10, 25]");
    EXPECT_EQ(jsonValueAsTickRange(parseJson("[10, 25]")), Range<long long>(10, 25));
}

TEST(ValueTraits, WrongShapesAreRefusedWithTheValue) {
    EXPECT_THROW(ValueTraits<Point3d>::read(parseJson("[1, 2]")), ParserException);
    EXPECT_THROW(ValueTraits<TemplatedColor<int>>::read(parseJson("[1, 2, 3, 4.5]")), ParserException);
    EXPECT_THROW(ValueTraits<int>::read(parseJson("\"3\"")), ParserException);
    EXPECT_THROW(ValueTraits<TextAttributeList>::read(parseJson(
                     R"({"textAttributeList": {"text": "ab", "runs": [{"start": 1, "length": 5}]}})")),
                 ParserException);
}

// Every type in the instantiation list has a document form that gives its
// value back, alone and in a parameter; a type added without one does not compile here.
TEST(ValueTraits, EveryParameterValueTypeReadsBackWhatItWrote) {
#define VELA_EXPECT_READ_BACK(Type) expectReadBack<Type>();
    VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_EXPECT_READ_BACK)
#undef VELA_EXPECT_READ_BACK
    expectParameterReadsBack(
        InterpolatingParam<double>::create(project, "p", 1.0, SpringInterpolater<double>::getInstance()),
        std::vector<double>{2.0});
}

TEST(ValueTraits, TypeNamesAreDistinct) {
    std::multiset<std::string> names;
#define VELA_COLLECT_NAME(Type) names.insert(ValueTraits<Type>::typeName());
    VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_COLLECT_NAME)
#undef VELA_COLLECT_NAME
    EXPECT_EQ(names.count("interpolater"), 6u); // one per interpolated type
    names.erase("interpolater");
    EXPECT_EQ(std::set<std::string>(names.begin(), names.end()).size(), names.size());
    EXPECT_STREQ(ValueTraits<float>::typeName(), "?");
    EXPECT_STREQ(ValueTraits<long long>::typeName(), "int64");
    EXPECT_STREQ(ValueTraits<Rect<float>>::typeName(), "rect");
    EXPECT_STREQ(ValueTraits<TemplatedColor<int>>::typeName(), "color");
    EXPECT_STREQ(ValueTraits<Point3d>::typeName(), "point");
}

TEST(ValueTraits, SimilarityHasEachMembersTolerance) {
    EXPECT_TRUE(ValueTraits<float>::similar(1.0f, 1.0000005f));
    EXPECT_FALSE(ValueTraits<float>::same(1.0f, 1.0000005f));
    EXPECT_FALSE(ValueTraits<double>::similar(1.0, 1.000001));
    EXPECT_TRUE(ValueTraits<double>::similar(1e12, 1e12 + 1));
    EXPECT_TRUE(ValueTraits<Rect<float>>::similar(Rect<float>(1, 1, 1, 1), Rect<float>(1, 1, 1, 1.0000005f)));
    EXPECT_FALSE(ValueTraits<Point3d>::similar(Point3d(1, 1, 1), Point3d(1, 1, 1.000001)));
    EXPECT_FALSE(ValueTraits<int>::similar(1000000, 1000001));
    EXPECT_TRUE(ValueTraits<double>::similar(0.0, 1e-9)); // the tolerance itself is within it
    TransformMatrix::Elements elements{};
    elements[15] = 1e-3;
    EXPECT_FALSE(ValueTraits<TransformMatrix>::similar(TransformMatrix(), TransformMatrix(elements)));
    EXPECT_TRUE(ValueTraits<TransformMatrix>::similar(TransformMatrix(), TransformMatrix()));
    // Interpolaters are the same when they move values alike, as two Bézier instances of one curve do.
    const auto curve = InterpolaterFactory<Point3d>::byName("bezr(linr;0,0,0;1,1,1)");
    EXPECT_NE(curve, InterpolaterFactory<Point3d>::byName("bezr(linr;0,0,0;1,1,1)"));
    EXPECT_TRUE(ValueTraits<boost::shared_ptr<Interpolater<Point3d>>>::same(
        curve, InterpolaterFactory<Point3d>::byName("bezr(linr;0,0,0;1,1,1)")));
    EXPECT_FALSE(ValueTraits<boost::shared_ptr<Interpolater<Point3d>>>::same(curve, nullptr));
}

// Which "interp" names a document may give each type.
TEST(ValueTraits, EachTypeHasItsInterpolaterKinds) {
    EXPECT_TRUE(InterpolaterFactory<int>::find("bnce"));
    EXPECT_TRUE(InterpolaterFactory<long long>::find("esOt"));
    EXPECT_FALSE(InterpolaterFactory<long long>::find("sprg"));
    EXPECT_TRUE(InterpolaterFactory<TransformMatrix>::find("linr"));
    EXPECT_FALSE(InterpolaterFactory<AudioPosition>::find("eios"));
    EXPECT_FALSE(InterpolaterFactory<std::string>::find("linr"));
    EXPECT_FALSE(InterpolaterFactory<Rect<float>>::find("bezr(linr;0,0,0;1,1,1)"));
    EXPECT_EQ(InterpolaterFactory<CaptionData>::defaultInterpolater()->name(), "left");
    EXPECT_EQ(InterpolaterFactory<TemplatedColor<int>>::defaultInterpolater()->name(), "linr");
}

// A refused key or element writes nothing.
TEST(JSONWriter, IndentsNestedObjectsAndArraysAndRefusesWhatDoesNotBelong) {
    std::ostringstream out;
    XMLOptions options(out);
    {
        JSONWriter object(options, 0);
        EXPECT_THROW(options.element(), VelaMediaLibException);
        options.key("a") << 1;
        options.key("list");
        {
            JSONWriter list(options, object.memberLevel(), JSONWriter::Array);
            options.element() << 2;
            EXPECT_THROW(options.key("x"), VelaMediaLibException);
            options.element() << 3;
        }
        options.key("b") << 4; // the separator belongs to the object again
    }
    EXPECT_EQ(out.str(), "{\n  \"a\" : 1,\n  \"list\" : [\n    2,\n    3\n  ],\n  \"b\" : 4\n}");
    options.key("bare") << 5; // with nothing open, the key alone
    EXPECT_EQ(out.str().substr(out.str().size() - 10), "\"bare\" : 5");
    std::ostringstream empty;
    XMLOptions emptyOptions(empty);
    JSONWriter(emptyOptions, 1).close();
    EXPECT_EQ(empty.str(), "{\n  }");
}

TEST(XMLOptions, IdentsAndPaths) {
    std::ostringstream out;
    XMLOptions options(out);
    int a = 0, b = 0;
    EXPECT_EQ(options.assignNewIdent(&a), 1u);
    EXPECT_EQ(options.assignNewIdent(&b), 2u);
    EXPECT_EQ(options.findIdent(&a), 1u);
    EXPECT_EQ(options.findIdent(&out), 0u);
    EXPECT_EQ(options.modifyPath("/media/a.mp4"), "/media/a.mp4");
    options.setPathModifier([](const std::string& path) { return path.substr(path.rfind('/') + 1); });
    EXPECT_EQ(options.modifyPath("/media/a.mp4"), "a.mp4");
    EXPECT_EQ(options.indentation(2), "    ");
}
