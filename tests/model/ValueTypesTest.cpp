#include <VelaMediaLib/base/TextAttributeList.h>
#include <VelaMediaLib/base/TransformMatrix.h>

#include <cmath>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

TEST(TransformMatrix, ComposesRightToLeft) {
    EXPECT_EQ(TransformMatrix() * TransformMatrix::scaling(2, 3, 4), TransformMatrix::scaling(2, 3, 4));
    const TransformMatrix moveThenTurn =
        TransformMatrix::rotationZ(M_PI / 2) * TransformMatrix::translation(1, 0, 0);
    const Point3d p = moveThenTurn.apply(Point3d(1, 0, 0)); // (2, 0) turned a quarter: (0, 2)
    EXPECT_NEAR(p.x, 0.0, 1e-12);
    EXPECT_NEAR(p.y, 2.0, 1e-12);
    EXPECT_EQ(TransformMatrix::translation(1, 2, 3).apply(Point3d(1, 1, 1)), Point3d(2, 3, 4));
}

TEST(TextAttributeList, RunsStayInsideTheText) {
    TextAttributeList text("hello world");
    EXPECT_TRUE(text.addRun(0, 5, "bold", "true"));
    EXPECT_TRUE(text.addRun(3, 5, "bold", "false"));
    EXPECT_FALSE(text.addRun(6, 6, "size", "12"));
    EXPECT_EQ(text.runs().size(), 2u);
    EXPECT_EQ(text.attributeAt(1, "bold"), "true");
    EXPECT_EQ(text.attributeAt(4, "bold"), "false"); // the later run wins
    EXPECT_EQ(text.attributeAt(9, "bold"), "");
}
