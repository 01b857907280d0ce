#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>

#include <boost/shared_ptr.hpp>
#include <string>

namespace VelaMediaLib {

class XMLOptions;

/// An effect applied to a clip or a track. Effects are held and ordered by
/// their owner (an Effectable); the kinds of effect build on this base.
class VELAMEDIALIB_API Effect : public VelaObject {
public:
    virtual std::string effectName() const = 0;
    virtual boost::shared_ptr<Effect> cloneEffect() const = 0;
    /// Writes the effect's object, closed at indent (see JSONWriter.h). A kind
    /// without a document form of its own writes "_type" "Effect" and its
    /// "effectName".
    virtual void toJSON(XMLOptions& options, int indent) const;
};

} // namespace VelaMediaLib
