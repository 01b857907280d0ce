// The soak's run: random edits with a check after each, random undo and redo
// runs in between, and undo and redo of everything at the end.
#include "SoakDriver.h"

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/commands/framework/CommandHistory.h>
#include <VelaMediaLib/commands/framework/MultiCommand.h>
#include <VelaMediaLib/document/ProjectDocument.h>

#include <algorithm>
#include <regex>
#include <set>
#include <stdexcept>

namespace VelaMediaLib {
namespace soak {

void EditMakerRegistry::add(const std::string& family, int weight, const EditMaker& make) {
    if (weight < 1) throw std::invalid_argument("an edit maker needs a weight of at least 1");
    entries_.push_back(Entry{family, weight, make});
    total_ += weight;
}

const EditMakerRegistry::Entry& EditMakerRegistry::pick(Random& random) const {
    if (entries_.empty()) throw std::logic_error("no edit makers registered");
    long long left = between(random, 1, total_);
    for (const Entry& entry : entries_)
        if ((left -= entry.weight) <= 0) return entry;
    return entries_.back();
}

std::string kindOf(const std::string& broken) {
    if (broken.find("than its transitions") != std::string::npos) return "room";
    if (broken.find("transition names another clip") != std::string::npos) return "link";
    return std::string();
}

namespace {

// Which sub-command of a composite refused to be redone, at any depth: its
// sub-commands are redone one by one until one refuses, then undone again.
std::string refusingPart(const CommandPtr& command, CommandHandler* handler) {
    const auto composite = boost::dynamic_pointer_cast<MultiCommand>(command);
    if (!composite) return std::string();
    CommandHistory& inner = composite->commandHistory();
    inner.setHandler(handler);
    std::string found;
    size_t redone = 0;
    try {
        while (!inner.redoStack().empty()) {
            const CommandPtr next = inner.redoStack().back();
            if (!inner.redo()) {
                found = " in sub-command " + std::to_string(redone + 1) + " (" + next->name() + ")" +
                        refusingPart(next, handler);
                break;
            }
            ++redone;
        }
        for (; redone > 0; --redone) inner.undo();
    } catch (const std::exception& e) {
        found += std::string(" (looking further threw: ") + e.what() + ")";
    }
    inner.setHandler(nullptr);
    return found;
}

// A document is remembered by its hash for every depth of the undo stack
// whose state the run saw; 0 where it did not (before a follow-up ran).
typedef size_t Digest;
Digest digestOf(const std::string& document) {
    return std::max<Digest>(1, std::hash<std::string>()(document));
}

class Run {
public:
    Run(const SoakOptions& options, const EditMakerRegistry& registry)
        : options_(options), registry_(registry), random_(options.seed), state_(buildSoakProject(random_)),
          history_(*state_.project->commandHistory()) {}

    SoakResult go() {
        original_ = current_ = document();
        digests_.assign(1, digestOf(original_));
        check("the first project", true);
        for (step_ = 0; step_ < options_.edits && !full(); ++step_) {
            edit();
            if (options_.undoRunEvery > 0 && chance(random_, 100 / options_.undoRunEvery) && !full())
                undoRun();
        }
        result_.edits = step_;
        if (!full()) finish();
        return result_;
    }

private:
    std::string document() const { return projectToJSONString(*state_.project, true); }
    size_t depth() const { return history_.undoStack().size(); }
    bool full() const { return faults_ >= options_.maxViolations; }
    void violation(const std::string& what, const std::string& kind = std::string()) {
        const Violation found{options_.seed, step_, what, kind};
        faults_ += kind.empty();
        result_.violations.push_back(found);
    }
    // A broken invariant is reported as it appears, not again at every step
    // it stays broken (told apart by what broke where, not the clip's range).
    // One of a named kind, an open fault seen again and again as clips come
    // and go, is reported once a run for each clip.
    void check(const std::string& what, bool packed) {
        static const std::regex range(R"( \[-?\d+, -?\d+\)| \(\d+\))"), place(R"(^(group )?track \d+ )");
        const std::string broken = invariantViolations(state_, packed);
        std::set<std::string> found;
        std::map<std::string, std::string> fresh; // by kind
        for (size_t at = 0, end; (end = broken.find("; ", at)) != std::string::npos; at = end + 2) {
            const std::string one = broken.substr(at, end - at), kind = kindOf(one);
            const std::string key = std::regex_replace(one, range, "");
            const bool seen = kind.empty()
                                  ? broken_.count(key) > 0
                                  : !reportedNamed_.insert(std::regex_replace(key, place, "")).second;
            if (!seen) fresh[kind] += one + "; ";
            found.insert(key);
        }
        for (const auto& kind : fresh) violation(what + ": " + kind.second, kind.first);
        broken_.swap(found);
    }

    // Executes one command of the edit; a refusal must leave the document and history as they were.
    bool execute(const CommandPtr& command, const std::string& what, const std::string& family) {
        const size_t before = depth();
        bool done = false;
        std::string thrown;
        try {
            done = state_.project->execute(command);
        } catch (const VelaMediaLibException& e) {
            thrown = e.what();
            ++result_.thrown;
        } catch (const std::exception& e) {
            violation(what + ": threw an exception foreign to the library: " + e.what());
        }
        const std::string after = document();
        if (!done) {
            ++result_.refused;
            ++result_.refusedByFamily[family];
            if (after != current_)
                violation(what + (thrown.empty() ? " refused" : " threw \"" + thrown + "\"") +
                          " but changed the document");
            if (depth() != before) violation(what + " refused but changed the history");
        } else {
            if (depth() <= before) violation(what + " took effect but left no undo step");
            recordDepth(digestOf(after));
        }
        current_ = after;
        return done;
    }

    void recordDepth(Digest digest) {
        digests_.resize(depth() + 1, 0);
        digests_[depth()] = digest;
    }

    void edit() {
        const EditMakerRegistry::Entry& maker = registry_.pick(random_);
        Edit edit;
        try {
            edit = maker.make(random_, state_);
        } catch (const VelaMediaLibException&) { // refused as it was made
            ++result_.refused;
            ++result_.refusedByFamily[maker.family];
            ++result_.thrown;
            if (document() != current_) violation(maker.family + ": making an edit changed the document");
            return;
        } catch (const std::exception& e) {
            violation(maker.family +
                      ": making an edit threw an exception foreign to the library: " + e.what());
            return;
        }
        const std::string what = maker.family + ":" + edit.what;
        if (options_.trace) *options_.trace << "step " << step_ << " " << what << "\n";
        bool done = execute(edit.command, what, maker.family);
        if (done && edit.learn) edit.learn(state_);
        if (done) state_.rememberPlaced();
        if (done && options_.trace) *options_.trace << "  took effect: undo steps " << depth() << "\n";
        if (done && edit.second) {
            const size_t before = depth();
            done = execute(edit.second, what + " (second)", maker.family);
            if (done && edit.combine && depth() == before + 1) {
                history_.combineLastCommands();
                if (document() != current_) violation(what + ": folding two steps changed the document");
                recordDepth(digestOf(current_));
            }
        }
        if (done) {
            ++result_.applied;
            ++result_.appliedByFamily[maker.family];
        }
        check(what, true);
    }

    // An undo or redo: false, reported, when it refuses or throws.
    template <typename Step>
    bool replayed(Step step, const std::string& what) {
        try {
            if (step()) return true;
            violation(what + " refused");
        } catch (const std::exception& e) {
            violation(what + " threw: " + e.what());
        }
        return false;
    }

    // Undoes one step and checks the state it gives back against the one seen at that depth.
    bool undoOne(const std::string& what) {
        const size_t from = depth();
        const std::string name = history_.undoStack().back()->name();
        if (!replayed([&] { return history_.undo(); },
                      what + ": undoing step " + std::to_string(from) + " (" + name + ")"))
            return false;
        ++result_.undone;
        current_ = document();
        if (depth() != from - 1)
            violation(what + ": an undo did not take one step off");
        else if (digests_[depth()] && digests_[depth()] != digestOf(current_))
            violation(what + ": undoing step " + std::to_string(from) + " did not give back its document");
        check(what + ", after undoing step " + std::to_string(from), false);
        return true;
    }

    bool redoOne(const std::string& what) {
        const size_t from = depth();
        const std::string name = history_.redoStack().back()->name();
        const CommandPtr next = history_.redoStack().back();
        if (!replayed([&] { return history_.redo(); },
                      what + ": redoing step " + std::to_string(from + 1) + " (" + name + ")")) {
            result_.violations.back().what += refusingPart(next, history_.handler());
            return false;
        }
        current_ = document();
        if (depth() != from + 1)
            violation(what + ": a redo did not put one step back");
        else if (digests_[depth()] && digests_[depth()] != digestOf(current_))
            violation(what + ": redoing step " + std::to_string(depth()) + " did not give its document");
        check(what + ", after redoing step " + std::to_string(depth()), false);
        return true;
    }

    // A few steps back; mostly forward again to the same document, else the
    // next edit discards them.
    void undoRun() {
        const size_t steps = std::min<size_t>(depth(), size_t(between(random_, 1, 6)));
        const std::string before = current_;
        size_t undone = 0;
        while (undone < steps && undoOne("an undo run")) ++undone;
        if (chance(random_, 25)) {
            // Back to a state an edit left (not one between an edit and its
            // magnetizer's follow-up), then the undone steps are dropped now,
            // as the next edit would drop them, so redoing everything ends here.
            while (depth() > 0 && !digests_[depth()] && undoOne("an undo run")) {}
            history_.restoreState(CommandHistoryState{history_.undoStack(), {}});
            digests_.resize(depth() + 1);
            return;
        }
        for (size_t i = 0; i < undone && redoOne("a redo run"); ++i) {}
        if (current_ != before) violation("undoing and redoing a run did not give back the document");
    }

    void finish() {
        const std::string last = current_;
        ++step_; // violations of the final undo and redo are reported past the last edit
        while (depth() > 0 && !full())
            if (!undoOne("undoing everything")) break;
        if (current_ != original_) violation("undoing everything did not give back the first document");
        try {
            while (!history_.redoStack().empty() && !full())
                if (!redoOne("redoing everything")) break;
        } catch (const std::exception& e) {
            violation(std::string("redoing everything threw: ") + e.what());
        }
        current_ = document();
        if (current_ != last) violation("redoing everything did not give back the last document");
        check("after redoing everything", true);
    }

    const SoakOptions& options_;
    const EditMakerRegistry& registry_;
    Random random_;
    SoakState state_;
    CommandHistory& history_;
    long long step_ = 0;
    size_t faults_ = 0; // violations of no named kind: they end the run
    std::string original_, current_;
    std::set<std::string> broken_;        // the invariants broken at the last check
    std::set<std::string> reportedNamed_; // the named kinds' findings reported in this run
    std::vector<Digest> digests_;
    SoakResult result_;
};

} // namespace

SoakResult runSoak(const SoakOptions& options, const EditMakerRegistry& registry) {
    return Run(options, registry).go();
}

} // namespace soak
} // namespace VelaMediaLib
