#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/JSONReader.h>

namespace VelaMediaLib {

class GenericMixer;

/// Reads a mixer's track array into the mixer, each track placed at its
/// "trackIndex" (its place in the array when it has none). When the load
/// lets go of its tree, each track's subtree is released once it is built.
class VELAMEDIALIB_API MixerReader : public JSONReader {
public:
    MixerReader(const boost::shared_ptr<ReadContext>& context, const boost::shared_ptr<GenericMixer>& mixer);
    bool read(const Json::Value& tracks) override;

private:
    boost::shared_ptr<GenericMixer> mixer_;
};

} // namespace VelaMediaLib
