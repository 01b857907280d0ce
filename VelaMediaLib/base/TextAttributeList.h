#pragma once

#include <VelaMediaLib/base/Export.h>

#include <ostream>
#include <string>
#include <vector>

namespace VelaMediaLib {

/// Text with attribute runs: each run gives one attribute (a name such as
/// "fontSize" or "bold" and its value as text) to a span of the text's bytes.
class VELAMEDIALIB_API TextAttributeList {
public:
    struct Run {
        size_t start = 0;
        size_t length = 0;
        std::string name;
        std::string value;

        bool operator==(const Run& o) const {
            return start == o.start && length == o.length && name == o.name && value == o.value;
        }
    };

    TextAttributeList() = default;
    explicit TextAttributeList(std::string text) : text_(std::move(text)) {}

    const std::string& text() const { return text_; }
    const std::vector<Run>& runs() const { return runs_; }

    /// Adds a run; returns false, changing nothing, when it reaches past the text.
    bool addRun(size_t start, size_t length, const std::string& name, const std::string& value);
    /// The value that the last run covering the byte gives the attribute, or empty.
    std::string attributeAt(size_t position, const std::string& name) const;

    bool operator==(const TextAttributeList& o) const { return text_ == o.text_ && runs_ == o.runs_; }
    bool operator!=(const TextAttributeList& o) const { return !(*this == o); }

private:
    std::string text_;
    std::vector<Run> runs_;
};

VELAMEDIALIB_API std::ostream& operator<<(std::ostream& out, const TextAttributeList& list);

} // namespace VelaMediaLib
