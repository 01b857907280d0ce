#pragma once

#include <VelaMediaLib/base/Export.h>

namespace VelaMediaLib {

class AMFile;
class Callout;
class Caption;
class ColorMedia;
class Group;
class IMFile;
class Media;
class PlaceholderMedia;
class ScreenIMFile;
class ScreenVMFile;
class UnifiedMedia;
class StitchedMedia;
class VMFile;

/// A visitor over the concrete clip kinds; each kind's dispatch calls the
/// operation of its own kind. Kinds a visitor does not handle fall through
/// to dispatchAnyMedia, which does nothing unless overridden.
class VELAMEDIALIB_API MediaDispatcher {
public:
    virtual ~MediaDispatcher() = default;
    virtual void dispatchPlaceholderMedia(PlaceholderMedia& media);
    virtual void dispatchColorMedia(ColorMedia& media);
    virtual void dispatchVMFile(VMFile& media);
    virtual void dispatchAMFile(AMFile& media);
    virtual void dispatchIMFile(IMFile& media);
    virtual void dispatchScreenVMFile(ScreenVMFile& media);
    virtual void dispatchScreenIMFile(ScreenIMFile& media);
    virtual void dispatchCallout(Callout& media);
    virtual void dispatchCaption(Caption& media);
    virtual void dispatchGroup(Group& media);
    virtual void dispatchUnifiedMedia(UnifiedMedia& media);
    virtual void dispatchStitchedMedia(StitchedMedia& media);

protected:
    virtual void dispatchAnyMedia(Media&) {}
};

/// The same over clips that are only read.
class VELAMEDIALIB_API ConstMediaDispatcher {
public:
    virtual ~ConstMediaDispatcher() = default;
    virtual void dispatchPlaceholderMedia(const PlaceholderMedia& media);
    virtual void dispatchColorMedia(const ColorMedia& media);
    virtual void dispatchVMFile(const VMFile& media);
    virtual void dispatchAMFile(const AMFile& media);
    virtual void dispatchIMFile(const IMFile& media);
    virtual void dispatchScreenVMFile(const ScreenVMFile& media);
    virtual void dispatchScreenIMFile(const ScreenIMFile& media);
    virtual void dispatchCallout(const Callout& media);
    virtual void dispatchCaption(const Caption& media);
    virtual void dispatchGroup(const Group& media);
    virtual void dispatchUnifiedMedia(const UnifiedMedia& media);
    virtual void dispatchStitchedMedia(const StitchedMedia& media);

protected:
    virtual void dispatchAnyMedia(const Media&) {}
};

} // namespace VelaMediaLib
