#include "TextDifference.h"

#include <algorithm>
#include <ostream>

namespace VelaTool {

namespace {

/// A line longer than this (a compact document is one line) is shown as the
/// stretch around the difference.
const size_t kShown = 100;

} // namespace

TextDifference::TextDifference(const std::string& expected, const std::string& actual) {
    const auto mismatch = std::mismatch(expected.begin(), expected.end(), actual.begin(), actual.end());
    if (mismatch.first == expected.end() && mismatch.second == actual.end()) return;
    equal_ = false;
    const size_t offset = size_t(mismatch.first - expected.begin());
    const size_t lineStart = offset == 0 ? 0 : expected.rfind('\n', offset - 1) + 1; // npos + 1 == 0
    line_ = size_t(std::count(expected.begin(), mismatch.first, '\n')) + 1;
    column_ = offset - lineStart + 1;
    expectedLine_ = lineAround(expected, offset);
    actualLine_ = lineAround(actual, offset);
}

std::string TextDifference::lineAround(const std::string& text, size_t offset) {
    if (offset >= text.size()) return "(end of text)";
    size_t start = offset == 0 ? 0 : text.rfind('\n', offset - 1) + 1;
    size_t end = std::min(text.find('\n', offset), text.size());
    if (offset - start > kShown / 2) start = offset - kShown / 2;
    end = std::min(end, start + kShown);
    return text.substr(start, end - start);
}

void TextDifference::print(std::ostream& out, const char* expectedName, const char* actualName) const {
    if (equal_) return;
    out << "first difference at line " << line_ << ", column " << column_ << ":\n";
    out << "  " << expectedName << ": " << expectedLine_ << "\n";
    out << "  " << actualName << ": " << actualLine_ << "\n";
}

} // namespace VelaTool
