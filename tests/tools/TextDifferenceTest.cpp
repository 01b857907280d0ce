#include "TextDifference.h"

#include <gtest/gtest.h>

#include <sstream>

using VelaTool::TextDifference;

TEST(TextDifference, EqualTextsHaveNone) {
    EXPECT_TRUE(TextDifference("{\n}\n", "{\n}\n").equal());
    EXPECT_TRUE(TextDifference("", "").equal());
}

TEST(TextDifference, NamesLineColumnAndBothLines) {
    const TextDifference difference("{\n  \"a\": 1,\n  \"b\": 2\n}\n", "{\n  \"a\": 1,\n  \"b\": 3\n}\n");
    ASSERT_FALSE(difference.equal());
    EXPECT_EQ(3u, difference.line());
    EXPECT_EQ(8u, difference.column());
    std::ostringstream out;
    difference.print(out, "document", "rewrite");
    EXPECT_EQ("first difference at line 3, column 8:\n  document:   \"b\": 2\n  rewrite:   \"b\": 3\n",
              out.str());
}

TEST(TextDifference, OneTextEndingEarlierDiffersWhereItEnds) {
    const TextDifference shorter("{}\n", "{}");
    ASSERT_FALSE(shorter.equal());
    EXPECT_EQ(1u, shorter.line());
    EXPECT_EQ(3u, shorter.column());
    std::ostringstream out;
    shorter.print(out, "a", "b");
    EXPECT_NE(std::string::npos, out.str().find("b: (end of text)"));
}

TEST(TextDifference, ShowsOnlyTheStretchAroundADifferenceInALongLine) {
    const std::string line(1000, 'x');
    const TextDifference difference(line + "a" + line, line + "b" + line);
    EXPECT_EQ(1001u, difference.column());
    std::ostringstream out;
    difference.print(out, "a", "b");
    EXPECT_LT(out.str().size(), 300u);
    EXPECT_NE(std::string::npos, out.str().find("xa"));
    EXPECT_NE(std::string::npos, out.str().find("xb"));
}
