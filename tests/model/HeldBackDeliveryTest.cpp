// Held-back notifications keep what they deliver alive, and observers of subjects with a mutex of their own
// are done once detach has returned.
#include "../ThreadTestSupport.h"

#include <VelaMediaLib/commands/framework/CommandHistory.h>
#include <VelaMediaLib/commands/edits/InternalProject.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>

#include <gtest/gtest.h>
#include <thread>

using namespace VelaMediaLib;
using namespace VelaMediaLib::testing;

// The host lets go of a clip while its held-back notification is delivered on another thread: the observer,
// which is told the clip itself, finds it whole, and the clip goes once its observers have heard.
TEST(ModelDeliveryConcurrency, AClipLetGoOfDuringItsDeliveryStaysWholeUntilItsObserversHaveHeard) {
    Deadline deadline;
    const ProjectPtr project = Project::create(30, 1);
    MediaPtr clip =
        PlaceholderMedia::createFromMediaRange(project->token(), project->editRateToken(), 0, 0, 10, 1);
    const boost::weak_ptr<Media> watched = clip;
    std::atomic<bool> delivering{false}, letGo{false};
    bool letGoDuringDelivery = false;
    std::string name;
    VelaTime limit = -1;
    BlockingObserver reader;
    reader.body = [&](Observable* changed) {
        delivering = true;
        letGoDuringDelivery = waitFor(letGo, std::chrono::seconds(30));
        if (!letGoDuringDelivery) return;
        Media& media = dynamic_cast<Media&>(*changed);
        name = media.identifier();
        limit = media.trimEndLimit();
    };
    clip->attach(&reader);
    std::thread host([&] {
        waitFor(delivering, std::chrono::seconds(30));
        clip.reset();
        letGo = true;
    });
    {
        NotifyDelay delay(project->token().lock());
        clip->setIdentifier("renamed");
    }
    host.join();
    EXPECT_TRUE(letGoDuringDelivery) << "letting go waited for the delivery";
    EXPECT_EQ(name, "renamed");
    EXPECT_EQ(limit, 0);
    EXPECT_TRUE(watched.expired());
}

// The command history notifies through a subject with a mutex of its own and no project: detaching on another
// thread returns once the observer is done.
TEST(ModelDeliveryConcurrency, HistoryDetachReturnsOnlyOnceItsObserverHasFinished) {
    Deadline deadline;
    const ProjectPtr project = Project::create(30, 1);
    const boost::shared_ptr<CommandHistory> history = project->commandHistory();
    BlockingObserver slow;
    history->attach(&slow);
    EXPECT_FALSE(detachReturnsWhileTheObserverRuns(
        slow, [&] { history->setUndoLimit(5); }, [&] { history->detach(&slow); }));
}
