#pragma once
// A large project document for the load and write benchmarks, generated as
// text in the library's own form (no library call), the same on every run:
// `tracks` tracks of `clipsPerTrack` video clips, each track playing a
// source of its own, a keyframed opacity on every `keyframedEvery`-th clip.

#include <string>

namespace VelaBench {

struct DocumentShape {
    int tracks = 10;
    int clipsPerTrack = 10000;
    int keyframedEvery = 10;
    /// No line breaks or indentation, as `vela fmt --compact` writes.
    bool compact = false;
};

class DocumentGenerator {
public:
    explicit DocumentGenerator(const DocumentShape& shape) : shape_(shape) {}

    std::string text() const;
    long long clipCount() const { return (long long)shape_.tracks * shape_.clipsPerTrack; }

private:
    class Writer;
    void writeSources(Writer& out) const;
    void writeTimeline(Writer& out) const;
    void writeTrack(Writer& out, int track) const;
    void writeClip(Writer& out, int track, int clip) const;
    void writeOpacity(Writer& out) const;

    DocumentShape shape_;
};

} // namespace VelaBench
