#include <VelaMediaLib/base/AudioPosition.h>
#include <VelaMediaLib/base/CaptionData.h>
#include <VelaMediaLib/base/IdentManager.h>
#include <VelaMediaLib/base/KeystrokeData.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/base/TemplatedColor.h>
#include <VelaMediaLib/base/TextAttributeList.h>
#include <VelaMediaLib/base/TransformMatrix.h>
#include <VelaMediaLib/time/rational/ScaledTimeRange.h>

#include <cmath>
#include <gtest/gtest.h>

using namespace VelaMediaLib;

namespace {

// A value equals itself and differs from each value that changes one member.
template <typename T>
void expectEachMemberCounts(const T& value, const std::vector<T>& oneMemberChanged) {
    EXPECT_TRUE(value == value);
    EXPECT_FALSE(value != value);
    for (size_t i = 0; i < oneMemberChanged.size(); ++i) {
        EXPECT_FALSE(value == oneMemberChanged[i]) << "change " << i;
        EXPECT_TRUE(value != oneMemberChanged[i]) << "change " << i;
    }
}

} // namespace

TEST(ValueTypes, EveryMemberTakesPartInEquality) {
    expectEachMemberCounts(Rect<float>(1, 2, 3, 4), {{9, 2, 3, 4}, {1, 9, 3, 4}, {1, 2, 9, 4}, {1, 2, 3, 9}});
    expectEachMemberCounts(TemplatedColor<int>(1, 2, 3, 4),
                           {{9, 2, 3, 4}, {1, 9, 3, 4}, {1, 2, 9, 4}, {1, 2, 3, 9}});
    expectEachMemberCounts(Point3d(1, 2, 3), {{9, 2, 3}, {1, 9, 3}, {1, 2, 9}});
    expectEachMemberCounts(AudioPosition(0.5, 0.25), {{0.1, 0.25}, {0.5, 0.1}});
    expectEachMemberCounts(CaptionData("hi", "en"), {{"ho", "en"}, {"hi", "fr"}});
    expectEachMemberCounts(KeystrokeData("k", 1), {{"j", 1}, {"k", 2}});
    TransformMatrix::Elements elements{};
    std::vector<TransformMatrix> changed;
    for (size_t i = 0; i < elements.size(); ++i) {
        TransformMatrix::Elements one = elements;
        one[i] = 1;
        changed.emplace_back(one);
    }
    expectEachMemberCounts(TransformMatrix(elements), changed);
    expectEachMemberCounts(ScaledTimeRange(30, 10, 5),
                           {ScaledTimeRange(30, 11, 5), ScaledTimeRange(30, 10, 6)});
}

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
    EXPECT_TRUE(text.addRun(6, 5, "size", "12")); // up to the last character
    EXPECT_EQ(text.runs().size(), 3u);
    EXPECT_EQ(text.attributeAt(1, "bold"), "true");
    EXPECT_EQ(text.attributeAt(4, "bold"), "false"); // the later run wins
    EXPECT_EQ(text.attributeAt(9, "bold"), "");
}

TEST(IdentManager, RetiredIdentifiersComeBackLastInFirstOut) {
    IdentManager manager;
    for (uint32_t expected = 0; expected < 9; ++expected) EXPECT_EQ(manager.newIdent(), expected);
    manager.retireIdent(5);
    manager.retireIdent(7);
    EXPECT_EQ(manager.newIdent(), 7u);
    EXPECT_EQ(manager.newIdent(), 5u);
    EXPECT_EQ(manager.newIdent(), 9u);
}
