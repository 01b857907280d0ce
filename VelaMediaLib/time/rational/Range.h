#pragma once
// A small pair used for start-and-duration ranges throughout the library.

#include <VelaMediaLib/base/Export.h>

#include <ostream>

namespace VelaMediaLib {

template <typename T>
class VELAMEDIALIB_TEMPLATE_API Range {
public:
    Range() : first_(), second_() {}
    Range(T first, T second) : first_(first), second_(second) {}
    virtual ~Range() = default;
    Range(const Range&) = default;
    Range& operator=(const Range&) = default;

    const T& first() const { return first_; }
    const T& second() const { return second_; }
    void setFirst(const T& value) { first_ = value; }
    void setSecond(const T& value) { second_ = value; }

    /// Ranges hold a start and a duration; these name them so.
    const T& start() const { return first_; }
    const T& duration() const { return second_; }
    T end() const { return first_ + second_; }

    bool operator==(const Range& other) const { return first_ == other.first_ && second_ == other.second_; }
    bool operator!=(const Range& other) const { return !(*this == other); }

private:
    T first_;
    T second_;
};

template <typename T>
std::ostream& operator<<(std::ostream& out, const Range<T>& range) {
    return out << "[" << range.first() << ", " << range.second() << "]";
}

} // namespace VelaMediaLib
