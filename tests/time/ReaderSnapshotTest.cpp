#include "TimeTestSupport.h"

#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/make_shared.hpp>
#include <functional>
#include <gtest/gtest.h>

using namespace VelaMediaLib;
using VelaMediaLib::testing::Deadline;
using VelaMediaLib::testing::Knob;

namespace {

// A reader holds the read lock while a writer waits for the write lock. What the reader first uses inside its
// snapshot (and is made on demand) must not let the writer in: the writer's change stays unseen until the
// reader lets go.
class ReaderSnapshot : public ::testing::Test {
protected:
    void expectSnapshotHoldsAcross(const std::function<void()>& firstUse) {
        Deadline deadline;
        const auto witness = ParameterImpl<double>::create(project, "witness", 0.0);
        std::thread writer;
        {
            ScopedReadLock snapshot(project);
            writer = std::thread([&] { witness->setDefaultValue(1.0); });
            while (!project->mutex().hasWriter()) std::this_thread::yield();
            firstUse();
            EXPECT_EQ(witness->valueAtTime(RationalTime(0)), 0.0);
        }
        writer.join();
        EXPECT_EQ(witness->valueAtTime(RationalTime(0)), 1.0);
    }
    boost::shared_ptr<ThreadSafe> project = boost::make_shared<ThreadSafe>();
    Knob knob{project};
};

} // namespace

TEST_F(ReaderSnapshot, PartsMadeOnFirstUseLetNoWriterIn) {
    const auto parameter = ParameterImpl<double>::create(project, "gain", 2.0);
    const std::pair<const char*, std::function<void()>> firstUses[] = {
        {"a declared parameter",
         [&] { EXPECT_EQ(knob.typedParameter<double>("level")->valueAtTime(0), 1.0); }},
        {"a parameter's identifier attribute",
         [&] { EXPECT_EQ(parameter->identAttribute()->value(), "gain"); }},
        {"a parameter's metadata", [&] { EXPECT_TRUE(parameter->metaDataPtr()->metaDataKeys().empty()); }},
        {"an attribute made with its initial value",
         [&] { EXPECT_FALSE(knob.attributeOrAdd<bool>("solo", false)->value()); }}};
    for (const auto& firstUse : firstUses) {
        SCOPED_TRACE(firstUse.first);
        expectSnapshotHoldsAcross(firstUse.second);
    }
    EXPECT_TRUE(knob.hasMadeParameter("level"));
    EXPECT_EQ(parameter->identAttribute(), parameter->identAttribute()); // made once
    EXPECT_EQ(parameter->metaDataPtr(), parameter->metaDataPtr());
}

TEST_F(ReaderSnapshot, AttributesKeepOneTypePerName) {
    knob.addAttribute<int>("width", 640);
    EXPECT_EQ(knob.attributeOrAdd<int>("width", 1)->value(), 640);
    EXPECT_THROW(knob.attributeOrAdd<bool>("width", false), TypeException);
    EXPECT_THROW(knob.addAttribute<bool>("width", false), TypeException);
    EXPECT_EQ(knob.attributeNames(), std::vector<std::string>{"width"});
}
