// Readers ask the source bin, its sources and their clips while the editing
// thread imports, undoes, changes files, swaps sources and changes the edit
// rate, and while another thread changes the loader list.
#include "../ThreadTestSupport.h"
#include "../model/SourceTestSupport.h"

#include <VelaMediaLib/commands/edits/LoadSourceCmd.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <atomic>
#include <gtest/gtest.h>
#include <thread>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

namespace {

const int kFiles = 8;
std::string pathOf(int i) { return "take" + std::to_string(i) + ".mov"; }

} // namespace

TEST(SourceConcurrencyTest, ReadersSeeWholeSourcesWhileTheBinAndLoadersChange) {
    Deadline deadline;
    RegisteredTableLoader table;
    for (int i = 0; i < kFiles; ++i)
        table->set(pathOf(i), {stream(TrackType::Video, 0, 600 * (i + 1), 600),
                               stream(TrackType::Audio, 0, 48000, 48000, 2)});
    table->set("longer.mov",
               {stream(TrackType::Video, 0, 60000, 600), stream(TrackType::Audio, 0, 96000, 48000, 2)});
    const ProjectPtr project = Project::create(30, 1);
    const SourcePtr first = project->loadSource(pathOf(0)), second = project->loadSource(pathOf(1));
    const auto track = project->timeline()->newTrack();
    project->timeline()->addTrack(project->newMixer("main"), track);
    const auto clip = VMFile::create(first, 0, 0);
    track->addMedia(clip, 0);

    std::atomic<bool> done{false};
    std::atomic<int> wrong{0};
    auto read = [&](int thread) {
        for (int i = thread; !done.load(); ++i) {
            if (const SourcePtr found = project->sourceBin()->sourceForFile(pathOf(i % kFiles)))
                wrong += found->numTracks() != 2 || found->timeRangeForTrack(1).duration() <= 0;
            const auto playing = clip->source();
            wrong += playing != first && playing != second;
            wrong += clip->maxRationalMediaEnd() < clip->minRationalMediaStart();
            for (const SourcePtr& source : project->sourceBin()->sources())
                wrong += !source->mediaForTrackNumber(0);
        }
    };
    auto churn = [&] {
        const auto unhelpful = boost::make_shared<TableStatsLoader>();
        while (!done.load()) {
            MediaFileStats::addStatsLoader(unhelpful, 1);
            MediaFileStats::removeStatsLoader(unhelpful);
        }
    };
    auto importer = [&] { // loads meet the rate changes of the editing thread
        for (int i = 0; !done.load(); ++i) {
            table->set("imported" + std::to_string(i) + ".mov", {stream(TrackType::Video, 0, 600, 600)});
            project->loadSource("imported" + std::to_string(i) + ".mov");
        }
    };
    std::thread readers[] = {std::thread(read, 0), std::thread(read, 1), std::thread(churn),
                             std::thread(importer)};
    for (int round = 0; round < 40; ++round) {
        for (int i = 2; i < kFiles; ++i) project->execute(LoadSourceCmd::create(pathOf(i)));
        project->timeline()->swapSourceForTimelineMedias(round % 2 ? second : first,
                                                         round % 2 ? first : second);
        project->setEditRate(boost::rational<unsigned long>(round % 2 ? 60 : 30));
        for (int i = 2; i < kFiles; ++i) project->undo();
    }
    project->changeSourcesFile(second, "longer.mov");
    done = true;
    for (std::thread& reader : readers) reader.join();
    EXPECT_EQ(wrong.load(), 0);
    for (const SourcePtr& source : project->sourceBin()->sources()) {
        EXPECT_EQ(source->editRate(), project->editRate()) << source->filename();
        const SafeRational length = source->rationalTimeRangeForTrack(0).second();
        EXPECT_EQ(source->mediaForTrackNumber(0)->duration(),
                  RationalUtil::toVelaTime(RationalUtil::Round(length)))
            << source->filename(); // its own clip is no older than its stats
    }
}
