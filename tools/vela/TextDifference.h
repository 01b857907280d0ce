#pragma once

#include <iosfwd>
#include <string>

namespace VelaTool {

/// Where two texts first differ: the line and column (from 1) and the two
/// lines there, or nothing when they are equal.
class TextDifference {
public:
    TextDifference(const std::string& expected, const std::string& actual);

    bool equal() const { return equal_; }
    size_t line() const { return line_; }
    size_t column() const { return column_; }
    /// "first difference at line L, column C:" and the two lines, each named.
    void print(std::ostream& out, const char* expectedName, const char* actualName) const;

private:
    static std::string lineAround(const std::string& text, size_t offset);

    bool equal_ = true;
    size_t line_ = 1, column_ = 1;
    std::string expectedLine_, actualLine_;
};

} // namespace VelaTool
