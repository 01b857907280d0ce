#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/time/rational/VelaTime.h>

namespace VelaMediaLib {

class Media;

/// The older editor family: the same operations in whole ticks and a double
/// scalar, carried out on the clip itself.
class VELAMEDIALIB_API MediaEditor : public VelaObject {
public:
    explicit MediaEditor(Media& clip) : clip_(clip) {}

    virtual void move(VelaTime offset);
    virtual void trimStart(VelaTime offset);
    virtual bool validTrimStart(VelaTime offset) const;
    virtual void trimEnd(VelaTime offset);
    virtual bool validTrimEnd(VelaTime offset) const;
    virtual double stretch(double factor);
    virtual VelaTime trimEndLimit() const;
    virtual VelaTime trimStartLimit() const;

protected:
    Media& clip_;
};

/// For clips with a media extent: an invalid trim, of either edge, throws
/// InvalidTrimRangeException "invalid media duration trim offset".
class VELAMEDIALIB_API TemporalEditor : public MediaEditor {
public:
    using MediaEditor::MediaEditor;
    void trimStart(VelaTime offset) override;
    void trimEnd(VelaTime offset) override;
};

/// For clips without a media extent.
class VELAMEDIALIB_API StaticEditor : public MediaEditor {
public:
    using MediaEditor::MediaEditor;
};

} // namespace VelaMediaLib
