#include <VelaMediaLib/document/format/JSONReader.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/ValueFormatter.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <cmath>
#include "../JsonTestSupport.h"

#include <gtest/gtest.h>
#include <json/reader.h>
#include <limits>
#include <random>
#include <sstream>

using namespace VelaMediaLib;

namespace {

template <typename T>
std::string text(const T& value) {
    std::ostringstream out;
    ValueFormatter<T>::write(out, value);
    return out.str();
}

} // namespace

TEST(ValueFormatter, DoublesReadBackAsTheSameDouble) {
    std::mt19937_64 random(7);
    std::uniform_real_distribution<double> spread(-1e6, 1e6);
    for (int i = 0; i < 2000; ++i) {
        const double value = spread(random) * std::pow(10.0, double(i % 40) - 20.0);
        EXPECT_EQ(ValueFormatter<double>::read(VelaMediaLib::testing::parseJson(text(value))), value)
            << text(value);
    }
    EXPECT_EQ(text(1.0), "1.0");
    EXPECT_EQ(text(0.1), "0.1");
    EXPECT_EQ(text(std::numeric_limits<double>::infinity()), "null");
    EXPECT_TRUE(std::isnan(ValueFormatter<double>::read(VelaMediaLib::testing::parseJson("null"))));
}

TEST(ValueFormatter, StringsAreEscapedAsJSONRequires) {
    const std::string awkward = std::string("a\"b\\c\n\t\x01 \xe2\x82\xac", 12);
    EXPECT_EQ(text(awkward), "\"a\\\"b\\\\c\\n\\t\\u0001 \xe2\x82\xac\"");
    EXPECT_EQ(ValueFormatter<std::string>::read(VelaMediaLib::testing::parseJson(text(awkward))), awkward);
}

TEST(ValueFormatter, RationalsAndTicks) {
    EXPECT_EQ(text(SafeRational(60000, 1001)), "\"60000/1001\"");
    EXPECT_EQ(text(SafeRational(30)), "30");
    EXPECT_EQ(JSONReader::jsonValueAsVelaRational(VelaMediaLib::testing::parseJson("\"60000/1001\"")),
              SafeRational(60000, 1001));
    EXPECT_EQ(JSONReader::jsonValueAsVelaRational(VelaMediaLib::testing::parseJson("30")), SafeRational(30));
    try {
        JSONReader::jsonValueAsVelaRational(VelaMediaLib::testing::parseJson("1.5"));
        FAIL();
    } catch (const ParserException& e) {
        EXPECT_STREQ(e.what(), "Invalid project json - unsupported json type for VelaRational: 1.5");
    }
    EXPECT_THROW(JSONReader::jsonValueAsVelaRational(VelaMediaLib::testing::parseJson("\"1/x\"")),
                 std::invalid_argument);
    EXPECT_THROW(
        JSONReader::jsonValueAsVelaRational(VelaMediaLib::testing::parseJson("\"99999999999999999999/1\"")),
        std::out_of_range);
    EXPECT_THROW(JSONReader::jsonValueAsVelaRational(VelaMediaLib::testing::parseJson("\"1/0\"")),
                 boost::bad_rational);
    EXPECT_EQ(text(Range<long long>(10, 25)), "[10, 25]");
    EXPECT_EQ(ValueFormatter<Range<long long>>::read(VelaMediaLib::testing::parseJson("[10, 25]")),
              Range<long long>(10, 25));
}

TEST(ValueFormatter, WrongShapesAreRefusedWithTheValue) {
    EXPECT_THROW(ValueFormatter<Point3d>::read(VelaMediaLib::testing::parseJson("[1, 2]")), ParserException);
    EXPECT_THROW(
        ValueFormatter<TemplatedColor<int>>::read(VelaMediaLib::testing::parseJson("[1, 2, 3, 4.5]")),
        ParserException);
    EXPECT_THROW(ValueFormatter<int>::read(VelaMediaLib::testing::parseJson("\"3\"")), ParserException);
    EXPECT_THROW(ValueFormatter<TextAttributeList>::read(VelaMediaLib::testing::parseJson(
                     R"({"text": "ab", "runs": [{"start": 1, "length": 5}]})")),
                 ParserException);
}

TEST(JSONWriter, IndentsNestedObjectsAndArrays) {
    std::ostringstream out;
    XMLOptions options(out);
    {
        JSONWriter object(options, 0);
        object.key("a") << 1;
        object.key("list");
        JSONWriter list(options, object.memberLevel(), JSONWriter::Array);
        list.element() << 2;
        list.element() << 3;
    }
    EXPECT_EQ(out.str(), "{\n  \"a\" : 1,\n  \"list\" : [\n    2,\n    3\n  ]\n}");
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
