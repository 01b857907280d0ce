#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONTree.h>
#include <VelaMediaLib/effects/Effect.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

#include <string>

namespace VelaMediaLib {

/// An effect kept whole as the document gave it, for effects the library has
/// no model of: its kind, name, category, whether it is bypassed, where it
/// stands on its clip, its behaviour parts ("in", "center", "out"), its
/// parameters and metadata. Immutable once made, so it is shared between
/// threads without a lock; a change makes a new effect.
class VELAMEDIALIB_API StoredEffect : public Effect {
public:
    /// The members of the effect's object. The trees stay null when the
    /// document had no such member, and are then not written.
    struct Fields {
        std::string type = "Effect"; // "_type"
        std::string effectName;
        std::string category;
        bool bypassed = false;
        VelaTime start = 0;
        VelaTime duration = 0;
        JSONTree in, center, out;
        JSONTree parameters;
        JSONTree metadata;
    };

    static boost::shared_ptr<StoredEffect> create(const Fields& fields);

    const Fields& fields() const { return fields_; }
    std::string effectName() const override { return fields_.effectName; }
    boost::shared_ptr<Effect> cloneEffect() const override;
    /// True for the effects that stay fitted to their clip's edges:
    /// "DeviceFrameEffect" and "CursorPath".
    bool isMagnetized() const override;
    bool hasTimeRange() const override { return true; }
    Range<VelaTime> timeRange() const override { return Range<VelaTime>(fields_.start, fields_.duration); }
    boost::shared_ptr<Effect> withTimeRange(const Range<VelaTime>& range) const override;
    /// "_type", "effectName", "category", "bypassed", "start", "duration",
    /// then "in", "center", "out", "parameters", "metadata" where present.
    void toJSON(XMLOptions& options, int indent) const override;

private:
    explicit StoredEffect(const Fields& fields) : fields_(fields) {}

    const Fields fields_;
};

typedef boost::shared_ptr<StoredEffect> StoredEffectPtr;

} // namespace VelaMediaLib
