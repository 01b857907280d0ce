#pragma once

#include <VelaMediaLib/model/project/Project.h>

#include <iosfwd>
#include <map>
#include <string>
#include <vector>

namespace VelaTool {

/// What `vela info` tells of a project: edit rate, canvas, length, tracks,
/// clips of every kind at any depth (inside groups, stitched and unified
/// clips too) and the sources with their offline status.
class ProjectSummary {
public:
    struct SourceLine {
        std::string path;
        bool online;
        std::string status;
    };

    explicit ProjectSummary(const VelaMediaLib::Project& project);

    void printText(std::ostream& out) const;
    /// One JSON object on one line: "editRate" ("n/d"), "width", "height",
    /// "duration" (ticks), "tracks", "clips" (counts by "_type"), "sources".
    void printJSON(std::ostream& out) const;

    size_t clipCount() const;
    const std::map<std::string, size_t>& clipsByKind() const { return clipsByKind_; }

private:
    void countClips(const VelaMediaLib::Project& project);
    void listSources(const VelaMediaLib::Project& project);

    unsigned long rateNumerator_, rateDenominator_;
    int width_, height_;
    long long duration_;
    size_t tracks_;
    std::map<std::string, size_t> clipsByKind_;
    std::vector<SourceLine> sources_;
};

} // namespace VelaTool
