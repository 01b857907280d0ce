// Taking unified clips apart: separating video and audio, removing the audio.
#include "../model/SourceTestSupport.h"
#include "EditTestSupport.h"

#include <VelaMediaLib/commands/edits/RemoveAudioCmd.h>
#include <VelaMediaLib/commands/edits/SeparateVideoAudioCmd.h>
#include <VelaMediaLib/commands/edits/TrimCmd.h>
#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/UnifiedMedia.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/source/Source.h>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

class UnifiedCommandTest : public EditTest {
protected:
    UnifiedCommandTest() {
        loader->set("rec.mov",
                    {stream(TrackType::Video, 0, 300, 30), stream(TrackType::Audio, 0, 480000, 48000, 2)});
        const SourcePtr source = project->sourceBin()->loadFile("rec.mov");
        const auto visual = VMFile::create(source, 0, 0);
        const auto audio = AMFile::create(source, 1, 0);
        unified = UnifiedMedia::create(visual, audio);
        known = {unified, visual, audio};
    }
    MediaPtr placeClip(VelaTime start, VelaTime duration, const TrackPtr& on) {
        known.push_back(PlaceholderMedia::create(project->token(), project->editRateToken(), 0, duration));
        boost::dynamic_pointer_cast<GenericTrack>(on)->addMedia(known.back(), start);
        return known.back();
    }
    // Every clip's timing, container and transitions, the unified parent of the
    // audio, each transition's links and each track's clips.
    std::vector<std::string> shot() const {
        std::vector<std::string> lines;
        const auto all = mixer->tracks();
        for (const MediaPtr& media : known) {
            const auto s = media->state();
            const auto parent = media->parent();
            std::ostringstream out;
            out << s.start << "+" << s.duration << " " << s.mediaStart << "+" << s.mediaDuration << " x"
                << s.scalar << " track " << indexIn(all, boost::dynamic_pointer_cast<Track>(parent))
                << " clip " << indexIn(known, boost::dynamic_pointer_cast<Media>(parent)) << " "
                << indexIn(transitions, media->leftTransition()) << "|"
                << indexIn(transitions, media->rightTransition());
            lines.push_back(out.str());
        }
        lines.push_back(indexIn(known, unified->internalAudioMedia()->parentUnifiedMedia()));
        for (const TransitionPtr& t : transitions)
            lines.push_back(indexIn(known, t->leftMedia()) + ">" + indexIn(known, t->rightMedia()));
        for (const TrackPtr& each : all) {
            lines.emplace_back("track:");
            for (const MediaPtr& media : each->medias()) lines.back() += " " + indexIn(known, media);
        }
        return lines;
    }
    // Runs the command (or asks that it is refused) and compares the whole state around undo and redo.
    void expectExactUndoOf(const CommandPtr& command, bool refused = false) {
        const auto before = shot();
        const size_t stepsBefore = steps();
        ASSERT_EQ(project->execute(command), !refused) << command->name();
        if (refused) {
            EXPECT_EQ(shot(), before);
            EXPECT_EQ(steps(), stepsBefore);
            return;
        }
        const auto after = shot();
        ASSERT_TRUE(project->undo());
        EXPECT_EQ(shot(), before) << command->name();
        ASSERT_TRUE(project->redo());
        EXPECT_EQ(shot(), after) << command->name();
    }

    RegisteredTableLoader loader;
    boost::shared_ptr<UnifiedMedia> unified;
    std::vector<MediaPtr> known; // the unified clip, its parts, then the others
};

TEST_F(UnifiedCommandTest, SeparatingPutsThePartsInSyncOnTwoTracksAndUndoesExactly) {
    const MediaPtr before = placeClip(0, 100, track);
    before->setRightTransition(transition()); // shared with the unified clip once it is placed
    track->addMedia(unified, 100);
    unified->setRightTransition(transition()); // on the unified clip alone
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, unified, 30)));
    const auto separate = SeparateVideoAudioCmd::create(track, unified);
    expectExactUndoOf(separate);

    const MediaPtr visual = unified->internalVisualMedia();
    const auto audio = unified->internalAudioMedia();
    ASSERT_EQ(mixer->numTracks(), 2u);
    EXPECT_EQ(separate->audioTrack(), mixer->trackAtIndex(1)); // right after the clip's track
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{before, visual}));
    EXPECT_EQ(audio->parentTrack(), separate->audioTrack());
    EXPECT_EQ(audio->state(), visual->state()); // the same slice at the same time
    EXPECT_EQ(visual->trackRange(), Range<VelaTime>(100, 270));
    EXPECT_EQ(audio->parentUnifiedMedia(), MediaPtr());
    EXPECT_EQ(std::make_pair(visual->leftTransition(), visual->rightTransition()),
              std::make_pair(transitions[0], transitions[1]));

    ASSERT_TRUE(
        project->execute(TrimEndCmd::create(track, visual, 50))); // apart, the parts go their own ways
    EXPECT_EQ(audio->duration(), 270);
    ASSERT_TRUE(project->undo());
    ASSERT_TRUE(project->undo());
    EXPECT_EQ(track->medias(), (std::vector<MediaPtr>{before, unified}));
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, unified, 50))); // together again
    EXPECT_EQ(audio->duration(), 220);
}

TEST_F(UnifiedCommandTest, SeparatingOntoAGivenTrackRefusesACollisionWhole) {
    track->addMedia(unified, 100);
    const auto audioTrack = newTrack();
    placeClip(390, 20, audioTrack);
    expectExactUndoOf(SeparateVideoAudioCmd::create(track, unified, audioTrack), true);
    ASSERT_TRUE(project->execute(TrimEndCmd::create(track, unified, 20)));
    expectExactUndoOf(SeparateVideoAudioCmd::create(track, unified, audioTrack));
    EXPECT_EQ(mixer->numTracks(), 2u); // no track made
    EXPECT_EQ(unified->internalAudioMedia()->parentTrack(), audioTrack);
}

TEST_F(UnifiedCommandTest, RemovingTheAudioLeavesTheVisualPartAlone) {
    track->addMedia(unified, 40);
    expectExactUndoOf(RemoveAudioCmd::create(track, unified));
    EXPECT_EQ(track->medias(), std::vector<MediaPtr>{unified->internalVisualMedia()});
    EXPECT_EQ(unified->internalVisualMedia()->startTime(), 40);
    EXPECT_EQ(unified->internalAudioMedia()->parent(), nullptr);
}

TEST_F(UnifiedCommandTest, ClipsThatAreNotUnifiedOrNotThereAreRefused) {
    const MediaPtr plain = placeClip(0, 10, track);
    track->addMedia(unified, 20);
    EXPECT_THROW(SeparateVideoAudioCmd::create(track, plain), TypeException);
    EXPECT_THROW(RemoveAudioCmd::create(track, plain), TypeException);
    EXPECT_THROW(RemoveAudioCmd::create(TrackPtr(), unified), VelaMediaLibException);
    EXPECT_THROW(SeparateVideoAudioCmd::create(track, unified, track), AddRemoveException);
    const auto elsewhere = newTrack();
    expectExactUndoOf(SeparateVideoAudioCmd::create(elsewhere, unified), true);
    expectExactUndoOf(RemoveAudioCmd::create(elsewhere, unified), true);
}

} // namespace
