#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

class Transition;

/// Reads a transition object ("name", "duration", "leftMedia", "rightMedia",
/// "attributes") and sets it on the clips it names (read before, by "id"):
/// the right edge of the left clip, the left edge of the right one. An id
/// naming no clip is refused: "Invalid project json - unknown media id: N".
class VELAMEDIALIB_API TransitionReader : public JSONReader {
public:
    using JSONReader::JSONReader;
    bool read(const Json::Value& value) override;
    const boost::shared_ptr<Transition>& transition() const { return transition_; }

private:
    boost::shared_ptr<Media> mediaOf(const Json::Value& value, const char* key) const;

    boost::shared_ptr<Transition> transition_;
};

} // namespace VelaMediaLib
