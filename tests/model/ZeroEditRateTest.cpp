#include "MediaTestSupport.h"

#include <gtest/gtest.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

boost::shared_ptr<TestClip> staticClipWithStartOffset(const boost::shared_ptr<ProjectEditRate>& rate) {
    MediaState state = timing(0, 30, 0, 30, 1, 0, 1000);
    state.hasStartOffset = true;
    state.startOffset = RationalTime(1, 2);
    return boost::make_shared<TestClip>(boost::weak_ptr<const ThreadSafe>(), rate, state, MediaImpl::Static);
}

} // namespace

// A static clip's start offset moves by the trim over the edit rate; with a
// rate of 0/1 there is no such time, and the trim is refused leaving the clip
// as it was.
TEST(ZeroEditRate, AStaticTrimAtRateZeroIsRefusedWholly) {
    const auto rate = boost::make_shared<SimpleProjectEditRate>(boost::rational<unsigned long>(30));
    const auto clip = staticClipWithStartOffset(rate);
    clip->trimStart(3);
    EXPECT_EQ(clip->state().startOffset, RationalTime(SafeRational(1, 2) + SafeRational(1, 10)));

    rate->setEditRate(boost::rational<unsigned long>(0));
    const MediaState before = clip->state();
    EXPECT_THROW(clip->trimStart(3), boost::bad_rational);
    EXPECT_EQ(clip->state(), before);
}
