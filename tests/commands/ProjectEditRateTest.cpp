#include "../time/TimeTestSupport.h"

#include <VelaMediaLib/commands/edits/InternalProject.h>

#include <gtest/gtest.h>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Rate;
using VelaMediaLib::testing::RateReader;

// Creating a project and setting its rate follow the one rule of every edit
// rate: a zero numerator gives 0/1 (with the frame and sample rates of a rate
// that is not one of theirs), a zero denominator makes no project.
TEST(ProjectEditRate, CreationAndSettingFollowTheOneRule) {
    const ProjectPtr zero = Project::create(0, 7);
    EXPECT_EQ(zero->editRate(), Rate(0, 1));
    EXPECT_EQ(zero->videoFormatFrameRateAttribute()->value(), 30);
    EXPECT_EQ(zero->audioFormatSampleRateAttribute()->value(), 44100);
    EXPECT_THROW(Project::create(25, 0), boost::bad_rational);

    const ProjectPtr project = Project::create(Rate(25));
    RateReader reader;
    reader.rate = project.get();
    project->attachEditRateObserver(&reader);
    project->setEditRate(Rate(0));
    project->setEditRate(SimpleProjectEditRate::rateOf(60, 2));
    EXPECT_EQ(reader.seen, (std::vector<Rate>{Rate(0, 1), Rate(30)}));
    project->detachEditRateObserver(&reader);
    project->setEditRate(Rate(50));
    EXPECT_EQ(reader.seen.size(), 2u);
}

// Clips hold the project's rate through its edit-rate token, and read what
// the project was last given.
TEST(ProjectEditRate, ClipsReadTheRateTheProjectHolds) {
    const ProjectPtr project = Project::create(30, 1);
    const boost::shared_ptr<ProjectEditRate> held = project->editRateToken().lock();
    ASSERT_TRUE(held);
    project->setEditRate(Rate(30000, 1001));
    EXPECT_EQ(held->editRate(), Rate(30000, 1001));
    held->setEditRate(Rate(24));
    EXPECT_EQ(project->editRate(), Rate(24));
}
