#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/parameters/MetaDatable.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

#include <boost/shared_ptr.hpp>
#include <string>

namespace VelaMediaLib {

class XMLOptions;

/// The type-independent face of a keyframe: when its value is reached (the
/// end time), how long the transition towards it lasts (the lead-in, the
/// document's "duration") and hence when that transition starts (the
/// document's "time"). Keyframes belong to their parameter and change only
/// through its operations; reading them takes the project's read lock.
class VELAMEDIALIB_API KeyFrameInterface : public MetaDatable {
public:
    KeyFrameInterface(const boost::weak_ptr<const ThreadSafe>& token, const RationalTime& endTime,
                      const RationalTime& leadIn);

    RationalTime endTime() const;
    /// The lead-in duration.
    RationalTime duration() const;
    /// The start of the transition: end time minus lead-in.
    RationalTime time() const;

    /// The name of the keyframe's own interpolater, or empty when it follows its parameter's.
    virtual std::string interpolaterName() const = 0;
    virtual boost::shared_ptr<KeyFrameInterface> cloneKeyFrame() const = 0;

    /// Writes the keyframe object ("time", "endTime", "value", "duration", then
    /// "interp" and "metadata" where it has them) with its members at indent + 1.
    void toJSON(XMLOptions& options, int indent) const;

protected:
    virtual void writeValue(XMLOptions& options, int indent) const = 0;
    /// The interpolater as a JSON value, or empty when there is none.
    virtual std::string interpolaterJson() const = 0;

    // Guarded by the project lock; the owning parameter edits them.
    RationalTime endTime_;
    RationalTime leadIn_;
};

} // namespace VelaMediaLib
