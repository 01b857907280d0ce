// The random-edit soak's short run (the long one is vela_soak, make soak):
// over a few seeds, random edits of every family, valid and invalid, keep the
// model's invariants, refused ones change nothing, and every undo and redo is
// exact. Also: the soak does catch an edit that breaks those rules.
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/model/media/PlaceholderMedia.h>

#include "soak/SoakDriver.h"

#include <boost/make_shared.hpp>
#include <gtest/gtest.h>
#include <sstream>

using namespace VelaMediaLib;
using namespace VelaMediaLib::soak;

namespace {

std::string listed(const std::vector<Violation>& violations) {
    std::ostringstream out;
    for (const Violation& v : violations)
        out << "\n  seed " << v.seed << " step " << v.step << ": " << v.what;
    return out.str();
}

// A host's edit of a clip's note that breaks one rule on purpose.
struct FaultyNoteCmd : Command {
    FaultyNoteCmd(const MediaPtr& media, bool refuseAfterChanging)
        : clip(media), refuse(refuseAfterChanging) {}
    bool execute(CommandHandler*) override {
        old = clip->metaDataValue("note");
        clip->addMetaData("note", old + "!");
        return !refuse;
    }
    bool unexecute(CommandHandler*) override { return true; } // forgets to put the note back
    MediaPtr clip;
    bool refuse;
    std::string old;
};

EditMaker faulty(bool refuseAfterChanging) {
    return [=](Random& random, SoakState& state) {
        Edit edit;
        edit.command = boost::make_shared<FaultyNoteCmd>(state.randomPlaced(random), refuseAfterChanging);
        edit.what = "a faulty note";
        return edit;
    };
}

TEST(RandomEditSoak, EveryFamilyKeepsTheInvariantsAndUndoesExactly) {
    EditMakerRegistry registry;
    addCoreMakers(registry);
    addFamilyMakers(registry);
    std::map<std::string, long long> applied, refused;
    for (uint64_t seed = 1; seed <= 4; ++seed) {
        SoakOptions options;
        options.seed = seed;
        options.edits = 500;
        const SoakResult result = runSoak(options, registry);
        EXPECT_TRUE(result.violations.empty()) << listed(result.violations);
        EXPECT_EQ(result.edits, 500);
        EXPECT_GT(result.undone, 0);
        for (const auto& entry : result.appliedByFamily) applied[entry.first] += entry.second;
        for (const auto& entry : result.refusedByFamily) refused[entry.first] += entry.second;
    }
    // Each maker makes edits that take effect and, drawn often enough, ones
    // that are refused (the draws are the same under every standard library).
    for (const EditMakerRegistry::Entry& entry : registry.entries()) {
        EXPECT_GT(applied[entry.family], 0) << entry.family;
        if (applied[entry.family] + refused[entry.family] >= 30) {
            EXPECT_GT(refused[entry.family], 0) << entry.family;
        }
    }
}

TEST(RandomEditSoak, ReportsARefusalThatChangedTheDocumentAndAnInexactUndo) {
    for (const bool refuse : {true, false}) {
        EditMakerRegistry registry;
        addCoreMakers(registry);
        registry.add("faulty", 200, faulty(refuse));
        SoakOptions options;
        options.seed = 7;
        options.edits = 60;
        options.maxViolations = 1000;
        const SoakResult result = runSoak(options, registry);
        ASSERT_FALSE(result.violations.empty()) << refuse;
        const std::string expected = refuse ? "refused but changed the document" : "did not give back";
        EXPECT_NE(listed(result.violations).find(expected), std::string::npos) << listed(result.violations);
        EXPECT_EQ(result.violations.front().seed, 7u);
    }
}

TEST(RandomEditSoak, InvariantsCatchABrokenTransitionLinkAndAnOverlongTransition) {
    Random random(3);
    SoakState state = buildSoakProject(random);
    ASSERT_EQ(invariantViolations(state, true), "");
    const MediaPtr clip = state.tracks()[1]->medias().back();
    const TransitionPtr transition = state.newTransition(clip->duration() + 2);
    clip->setRightTransition(transition);               // two ticks longer than the clip
    transition->setLeftMedia(boost::weak_ptr<Media>()); // and naming no clip
    const std::string found = invariantViolations(state, true);
    EXPECT_NE(found.find("right transition names another clip"), std::string::npos) << found;
    EXPECT_NE(found.find("than its transitions"), std::string::npos) << found;
}

} // namespace
