#include "../JsonTestSupport.h"
#include "AnimationTestSupport.h"

#include <VelaMediaLib/commands/edits/AddParameterKeyFrameInterfaceCmd.h>
#include <VelaMediaLib/commands/edits/ApplySerializedParameterValuesToMediaCmd.h>
#include <VelaMediaLib/commands/edits/MoveParameterKeyFrameCmd.h>
#include <VelaMediaLib/commands/edits/RemoveParameterKeyFrameCmd.h>
#include <VelaMediaLib/commands/edits/SetDoubleParameterValueInRangeCmd.h>
#include <VelaMediaLib/document/RemixParser.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>

#include <sstream>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class KeyFrameCommand : public DocumentEditTest {
protected:
    MediaPtr media = place(0, 100);
    boost::shared_ptr<Parameter<double>> opacity = opacityOf(media); // asked, so made, before any command

    boost::shared_ptr<KeyFrame<double>> keyframe(long long time, double value, long long leadIn = 0) {
        return boost::shared_ptr<KeyFrame<double>>(new KeyFrame<double>(
            boost::weak_ptr<const ThreadSafe>(), RationalTime(time), value, RationalTime(leadIn)));
    }
    void add(long long time, double value) {
        ASSERT_TRUE(
            project->execute(AddParameterKeyFrameInterfaceCmd::create(opacity, keyframe(time, value))));
    }
};

} // namespace

TEST_F(KeyFrameCommand, AddsMovesAndRemovesUndoToTheExactDocument) {
    expectExactDocumentUndo(AddParameterKeyFrameInterfaceCmd::create(opacity, keyframe(10, 0.5)));
    EXPECT_DOUBLE_EQ(opacity->valueAtTime(RationalTime(10)), 0.5);
    // At an occupied time the keyframe is replaced; undo gives the old one back.
    expectExactDocumentUndo(AddParameterKeyFrameInterfaceCmd::create(opacity, keyframe(10, 0.25, 4)));
    EXPECT_EQ(opacity->keyframeAtTime(RationalTime(10))->duration(), RationalTime(4));
    expectExactDocumentUndo(MoveParameterKeyFrameCmd::create(opacity, RationalTime(10), RationalTime(30)));
    EXPECT_TRUE(opacity->hasKeyFrameAtTime(RationalTime(30)));
    expectExactDocumentUndo(RemoveParameterKeyFrameCmd::create(opacity, RationalTime(30)));
    EXPECT_EQ(opacity->numKeyFrames(), 1u);
    add(30, 0.5);
    add(60, 0.0);
    expectExactDocumentUndo(RemoveAllKeyFramesCmd::create(opacity, RationalTime(45)));
    EXPECT_EQ(opacity->numKeyFrames(), 1u);
    EXPECT_DOUBLE_EQ(opacity->valueAtTime(RationalTime(0)), 0.25);
}

TEST_F(KeyFrameCommand, BadArgumentsThrowAndRefusalsChangeNothing) {
    add(30, 0.5);
    const auto text = boost::shared_ptr<KeyFrame<std::string>>(
        new KeyFrame<std::string>(boost::weak_ptr<const ThreadSafe>(), RationalTime(5), "five"));
    EXPECT_THROW(AddParameterKeyFrameInterfaceCmd::create(opacity, text), TypeException);
    EXPECT_THROW(AddParameterKeyFrameInterfaceCmd::create(opacity, nullptr), VelaMediaLibException);
    EXPECT_THROW(MoveParameterKeyFrameCmd::create(nullptr, RationalTime(0), RationalTime(1)),
                 VelaMediaLibException);
    expectRefusedDocument(
        AddParameterKeyFrameInterfaceCmd::create(opacity, keyframe(40, 0.1, -1))); // placement
    expectRefusedDocument(MoveParameterKeyFrameCmd::create(opacity, RationalTime(31), RationalTime(40)));
    expectRefusedDocument(MoveParameterKeyFrameCmd::create(opacity, RationalTime(30), RationalTime(0)));
    expectRefusedDocument(RemoveParameterKeyFrameCmd::create(opacity, RationalTime(31)));
    ASSERT_TRUE(project->execute(RemoveAllKeyFramesCmd::create(opacity)));
    expectRefusedDocument(RemoveAllKeyFramesCmd::create(opacity));                       // already constant
    expectRefusedDocument(RemoveParameterKeyFrameCmd::create(opacity, RationalTime(0))); // the only one
}

TEST_F(KeyFrameCommand, AValueInARangeChangesExactlyAtItsEdges) {
    add(100, 0.0); // fades from 1 at 0 to 0 at 100
    add(50, 0.5);
    expectExactDocumentUndo(SetDoubleParameterValueInRangeCmd::create(
        opacity, Range<RationalTime>(RationalTime(40), RationalTime(20)), 0.9));
    EXPECT_DOUBLE_EQ(opacity->valueAtTime(RationalTime(39)), 1.0); // a step into the range
    EXPECT_DOUBLE_EQ(opacity->valueAtTime(RationalTime(40)), 0.9);
    EXPECT_DOUBLE_EQ(opacity->valueAtTime(RationalTime(59)), 0.9);
    EXPECT_DOUBLE_EQ(opacity->valueAtTime(RationalTime(60)), 0.4); // what the fade had there
    EXPECT_FALSE(opacity->hasKeyFrameAtTime(RationalTime(50)));
    EXPECT_DOUBLE_EQ(opacity->valueAtTime(RationalTime(80)), 0.2);
    EXPECT_THROW(SetDoubleParameterValueInRangeCmd::create(
                     opacity, Range<RationalTime>(RationalTime(0), RationalTime(0)), 1),
                 ValueException<double>);
}

// Serialized values are a "parameters" object as the document writes one;
// parameters they make are forgotten on undo, so the document is as before.
TEST_F(KeyFrameCommand, SerializedValuesApplyWholeOrNotAtAll) {
    ASSERT_FALSE(media->hasMadeParameter("scale"));
    expectExactDocumentUndo(ApplySerializedParameterValuesToMediaCmd::create(
        media,
        "{\"opacity\": 0.5, \"scale\": {\"type\": \"point\", \"keyframes\": [{\"time\": 0, \"endTime\": 0, "
        "\"value\": [2.0, 2.0, 1.0], \"duration\": 0}]}}"));
    EXPECT_DOUBLE_EQ(opacity->valueAtTime(RationalTime(3)), 0.5);
    EXPECT_TRUE(media->hasMadeParameter("scale"));
    project->undo();
    EXPECT_FALSE(media->hasMadeParameter("scale"));
    EXPECT_EQ(thrown<VelaMediaLibException>(
                  [&] { ApplySerializedParameterValuesToMediaCmd::create(media, "{\"loudness\": 1}"); }),
              "the clip has no parameter \"loudness\"");
    EXPECT_THROW(ApplySerializedParameterValuesToMediaCmd::create(media, "[1]"), ParserException);
    const std::string before = document();
    const auto wrongType = ApplySerializedParameterValuesToMediaCmd::create(
        media, "{\"opacity\": 0.25, \"rotation\": \"sideways\"}");
    EXPECT_ANY_THROW(project->execute(wrongType));
    EXPECT_EQ(document(), before);
    EXPECT_FALSE(media->hasMadeParameter("rotation"));
    expectRefusedDocument(ApplySerializedParameterValuesToMediaCmd::create(media, "{\"opacity\": 1.0}"));
}

// An audio clip on a magnetic track whose volume was never made: the command
// makes it and its undo forgets it again.
TEST(KeyFrameCommandOnAudio, VolumeInARangeOnAMagneticTrackUndoesExactly) {
    const std::string text =
        "{\"version\": \"1.0\", \"editRate\": 30, \"sourceBin\": [{\"id\": 1, \"src\": \"/media/a.wav\", "
        "\"sourceTracks\": [{\"type\": \"audio\", \"range\": [0, 300], \"editRate\": 30, \"sampleRate\": "
        "44100}]}], "
        "\"timeline\": {\"id\": 2, \"sceneTrack\": {\"scenes\": [{\"velaml\": {\"tracks\": [{\"trackIndex\": "
        "0, "
        "\"magnetic\": true, \"medias\": [{\"id\": 3, \"_type\": \"AMFile\", \"src\": 1, \"trackNumber\": 0, "
        "\"start\": 0, \"duration\": 300, \"mediaStart\": 0, \"mediaDuration\": 300, \"scalar\": 1}], "
        "\"transitions\": []}]}}]}}}";
    RemixParser parser;
    std::istringstream in(text);
    parser.parse(in);
    const ProjectPtr project = parser.project();
    const MediaPtr sound = *project->timeline()->allMedias().begin();
    ASSERT_FALSE(sound->hasMadeParameter("volume"));
    const std::string before = projectToJSONString(*project);
    ASSERT_TRUE(project->execute(SetVolumeInRangeCmd::create(sound, Range<VelaTime>(30, 60), 0.5)));
    const std::string after = projectToJSONString(*project);
    EXPECT_EQ(project->commandHistory()->undoStack().size(), 1u); // no gap to close
    const auto volume = sound->typedParameter<double>("volume");
    EXPECT_DOUBLE_EQ(volume->valueAtTime(RationalTime(29)), 1.0);
    EXPECT_DOUBLE_EQ(volume->valueAtTime(RationalTime(30)), 0.5);
    EXPECT_DOUBLE_EQ(volume->valueAtTime(RationalTime(90)), 1.0);
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(projectToJSONString(*project), before);
    EXPECT_FALSE(sound->hasMadeParameter("volume"));
    ASSERT_TRUE(project->redo());
    EXPECT_EQ(projectToJSONString(*project), after);
    EXPECT_THROW(SetVolumeInRangeCmd::create(sound, Range<VelaTime>(0, 10), -1), ValueException<double>);
}
