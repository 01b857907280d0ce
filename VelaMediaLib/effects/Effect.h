#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

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
    /// Whether the effect follows the edge of its clip that it reaches when
    /// that edge is trimmed (a device frame around the whole clip stays around
    /// the whole clip).
    virtual bool isMagnetized() const { return false; }
    /// Whether the effect stands on a range of its clip; a kind without a
    /// place of its own covers the whole clip and is never moved or cut.
    virtual bool hasTimeRange() const { return false; }
    /// Where the effect stands on its clip, in the clip's own ticks (0 is the
    /// clip's start); a kind without a place of its own covers nothing.
    virtual Range<VelaTime> timeRange() const { return Range<VelaTime>(0, 0); }
    /// A copy standing on the range instead; null for a kind without a place.
    virtual boost::shared_ptr<Effect> withTimeRange(const Range<VelaTime>&) const {
        return boost::shared_ptr<Effect>();
    }
    /// Writes the effect's object, closed at indent (see JSONWriter.h). A kind
    /// without a document form of its own writes "_type" "Effect" and its
    /// "effectName".
    virtual void toJSON(XMLOptions& options, int indent) const;
};

} // namespace VelaMediaLib
