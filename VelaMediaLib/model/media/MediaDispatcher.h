#pragma once

#include <VelaMediaLib/base/Export.h>

namespace VelaMediaLib {

class Callout;
class Caption;
class ColorMedia;
class Media;
class PlaceholderMedia;

/// A visitor over the concrete clip kinds; each kind's dispatch calls the
/// operation of its own kind. Kinds a visitor does not handle fall through
/// to dispatchAnyMedia, which does nothing unless overridden.
class VELAMEDIALIB_API MediaDispatcher {
public:
    virtual ~MediaDispatcher() = default;
    virtual void dispatchPlaceholderMedia(PlaceholderMedia& media);
    virtual void dispatchColorMedia(ColorMedia& media);
    virtual void dispatchCallout(Callout& media);
    virtual void dispatchCaption(Caption& media);

protected:
    virtual void dispatchAnyMedia(Media&) {}
};

/// The same over clips that are only read.
class VELAMEDIALIB_API ConstMediaDispatcher {
public:
    virtual ~ConstMediaDispatcher() = default;
    virtual void dispatchPlaceholderMedia(const PlaceholderMedia& media);
    virtual void dispatchColorMedia(const ColorMedia& media);
    virtual void dispatchCallout(const Callout& media);
    virtual void dispatchCaption(const Caption& media);

protected:
    virtual void dispatchAnyMedia(const Media&) {}
};

} // namespace VelaMediaLib
