#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONTree.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <boost/shared_ptr.hpp>
#include <string>

namespace VelaMediaLib {

class XMLOptions;

/// A change applied over the first or last stretch of a clip, such as an
/// audio fade: its length, the group it belongs to (so that related changes
/// are added and removed together), and the function it applies, by name
/// ("FadeToValueFunc") and target value, and the parameters the document gave
/// it, kept whole.
class VELAMEDIALIB_API EdgeModification {
public:
    static const char* fadeToValueFunctionName() { return "FadeToValueFunc"; }

    EdgeModification(VelaTime duration, std::string group, double value,
                     std::string functionName = fadeToValueFunctionName())
        : duration_(duration), group_(std::move(group)), functionName_(std::move(functionName)),
          value_(value) {}

    VelaTime duration() const { return duration_; }
    void setDuration(VelaTime duration) { duration_ = duration; }
    const std::string& group() const { return group_; }
    const std::string& functionName() const { return functionName_; }
    double value() const { return value_; }
    const JSONTree& parameters() const { return parameters_; }
    void setParameters(const JSONTree& parameters) { parameters_ = parameters; }

    /// The modification's object, closed at indent: "duration", "group",
    /// "func": {"name", "value"}, "parameters" (when not empty).
    void toJSON(XMLOptions& options, int indent) const;

private:
    VelaTime duration_;
    std::string group_;
    std::string functionName_;
    double value_;
    JSONTree parameters_;
};

typedef boost::shared_ptr<EdgeModification> EdgeModificationPtr;

} // namespace VelaMediaLib
