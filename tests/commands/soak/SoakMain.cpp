// vela_soak: the long random-edit soak. Runs the edits in rounds, each from a
// fresh project with a seed of its own (the given seed plus the round's
// number), so that every violation it prints names the seed and step that
// reproduce it: vela_soak --seed <that seed> --edits <round length>.
#include "SoakDriver.h"

#include <chrono>
#include <cstdlib>
#include <cstring>
#include <iostream>
#include <map>
#include <string>

using namespace VelaMediaLib::soak;

namespace {

int usage() {
    std::cerr << "usage: vela_soak [--edits N] [--seed S] [--round R] [--trace]\n"
                 "  N edits in all (100000), in rounds of R edits (5000) from fresh projects;\n"
                 "  round r runs with seed S + r (S: 1). With --trace, a line per edit.\n"
                 "  Exits 1 when any violation was found.\n";
    return 2;
}

bool number(const char* text, long long& out) {
    char* end = nullptr;
    out = std::strtoll(text, &end, 10);
    return end && *end == '\0' && out >= 0;
}

} // namespace

int main(int argc, char** argv) {
    long long edits = 100000, seed = 1, round = 5000;
    bool trace = false;
    for (int i = 1; i < argc; ++i) {
        if (!std::strcmp(argv[i], "--trace")) {
            trace = true;
            continue;
        }
        long long* target = !std::strcmp(argv[i], "--edits")   ? &edits
                            : !std::strcmp(argv[i], "--seed")  ? &seed
                            : !std::strcmp(argv[i], "--round") ? &round
                                                               : nullptr;
        if (!target || i + 1 == argc || !number(argv[++i], *target)) return usage();
    }
    if (round < 1) return usage();

    EditMakerRegistry registry;
    addCoreMakers(registry);
    addFamilyMakers(registry);
    SoakResult total;
    std::map<std::string, long long> byKind;
    const auto began = std::chrono::steady_clock::now();
    for (long long r = 0, left = edits; left > 0; ++r, left -= round) {
        SoakOptions options;
        options.seed = uint64_t(seed + r);
        options.edits = std::min(left, round);
        if (trace) options.trace = &std::cout;
        const SoakResult result = runSoak(options, registry);
        for (const Violation& v : result.violations) {
            std::cout << "violation" << (v.kind.empty() ? "" : " (" + v.kind + ")") << ": seed " << v.seed
                      << " step " << v.step << ": " << v.what << "\n";
            ++byKind[v.kind];
        }
        if (result.edits < options.edits)
            std::cout << "seed " << options.seed << ": round given up after " << result.edits << " edits\n";
        total.edits += result.edits;
        total.applied += result.applied;
        total.refused += result.refused;
        total.thrown += result.thrown;
        total.undone += result.undone;
        for (const auto& entry : result.appliedByFamily) total.appliedByFamily[entry.first] += entry.second;
        for (const auto& entry : result.refusedByFamily) total.refusedByFamily[entry.first] += entry.second;
        total.violations.insert(total.violations.end(), result.violations.begin(), result.violations.end());
    }
    const double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - began).count();

    std::cout << "\nfamily: applied / refused\n";
    for (const EditMakerRegistry::Entry& entry : registry.entries())
        std::cout << "  " << entry.family << ": " << total.appliedByFamily[entry.family] << " / "
                  << total.refusedByFamily[entry.family] << "\n";
    std::cout << "edits run: " << total.edits << " (applied " << total.applied << ", refused "
              << total.refused << ", of which thrown " << total.thrown << "); steps undone " << total.undone
              << "\n"
              << "violations found: " << total.violations.size()
              << " (clips left shorter than their transitions: " << byKind["room"]
              << "; transition slots and links naming different clips: " << byKind["link"]
              << "; other: " << byKind[""] << ")\n"
              << "time: " << seconds << " s\n";
    return total.violations.empty() ? 0 : 1;
}
