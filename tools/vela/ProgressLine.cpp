#include "ProgressLine.h"

#include <iomanip>
#include <ostream>

namespace VelaTool {

ProgressLine::ProgressLine(std::ostream& err, std::string document)
    : err_(err), document_(std::move(document)), start_(std::chrono::steady_clock::now()) {}

void ProgressLine::sizeKnown(size_t bytes) {
    if (shown_ || bytes <= kThreshold) return;
    shown_ = true;
    err_ << "vela: loading " << document_ << " (" << std::fixed << std::setprecision(1)
         << double(bytes) / (1024.0 * 1024.0) << " MB):" << std::defaultfloat << std::flush;
}

void ProgressLine::stage(const char* what) {
    if (shown_ && !finished_) err_ << " " << what << std::flush;
}

void ProgressLine::finish(const char* failure) {
    if (!shown_ || finished_) return;
    finished_ = true;
    if (failure) {
        err_ << " " << failure << "\n";
        return;
    }
    const double seconds = std::chrono::duration<double>(std::chrono::steady_clock::now() - start_).count();
    err_ << " done in " << std::fixed << std::setprecision(1) << seconds << " s\n" << std::defaultfloat;
}

} // namespace VelaTool
