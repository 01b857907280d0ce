#pragma once

#include <chrono>
#include <iosfwd>
#include <string>

namespace VelaTool {

/// Tells on one line of the error stream how a long load goes: a document
/// over the threshold gets "vela: loading DOC (N MB): reading parsing done
/// in T s"; a small one gets nothing.
class ProgressLine {
public:
    static const size_t kThreshold = 10 * 1024 * 1024;

    ProgressLine(std::ostream& err, std::string document);
    /// Starts the line once the document is known to be large.
    void sizeKnown(size_t bytes);
    void stage(const char* what);
    /// Ends the line (with the failure, when there was one).
    void finish(const char* failure = nullptr);
    bool shown() const { return shown_; }

private:
    std::ostream& err_;
    std::string document_;
    bool shown_ = false;
    bool finished_ = false;
    std::chrono::steady_clock::time_point start_;
};

} // namespace VelaTool
