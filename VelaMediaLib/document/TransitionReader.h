#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

class Transition;

class Track;

/// Reads a transition object ("name", "duration", "leftMedia", "rightMedia",
/// "attributes") of a track and sets it on the clips it names (read before,
/// by "id"): the right edge of the left clip, the left edge of the right one.
/// Refused ("Invalid project json - ..."): an id naming no clip ("unknown
/// media id: N") and a clip of another track.
class VELAMEDIALIB_API TransitionReader : public JSONReader {
public:
    TransitionReader(const boost::shared_ptr<ReadContext>& context, const boost::shared_ptr<Track>& track)
        : JSONReader(context), track_(track) {}
    bool read(const Json::Value& value) override;
    const boost::shared_ptr<Transition>& transition() const { return transition_; }

private:
    boost::shared_ptr<Media> mediaOf(const Json::Value& value, const char* key) const;

    void checkSides(const std::string& name, const boost::shared_ptr<Media>& left,
                    const boost::shared_ptr<Media>& right) const;

    boost::shared_ptr<Track> track_;
    boost::shared_ptr<Transition> transition_;
};

} // namespace VelaMediaLib
