#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/MediaDispatcher.h>

#include <string>

namespace VelaMediaLib {

/// Names a clip's kind as the document's "_type" does.
class VELAMEDIALIB_API MediaTypeFromMediaDispatcher : public ConstMediaDispatcher {
public:
    void dispatchPlaceholderMedia(const PlaceholderMedia&) override { type_ = "PlaceholderMedia"; }
    void dispatchColorMedia(const ColorMedia&) override { type_ = "ColorMedia"; }
    void dispatchVMFile(const VMFile&) override { type_ = "VMFile"; }
    void dispatchAMFile(const AMFile&) override { type_ = "AMFile"; }
    void dispatchIMFile(const IMFile&) override { type_ = "IMFile"; }
    void dispatchScreenVMFile(const ScreenVMFile&) override { type_ = "ScreenVMFile"; }
    void dispatchScreenIMFile(const ScreenIMFile&) override { type_ = "ScreenIMFile"; }
    void dispatchCallout(const Callout&) override { type_ = "Callout"; }
    void dispatchCaption(const Caption&) override { type_ = "Caption"; }
    void dispatchGroup(const Group&) override { type_ = "Group"; }
    void dispatchUnifiedMedia(const UnifiedMedia&) override { type_ = "UnifiedMedia"; }
    void dispatchStitchedMedia(const StitchedMedia&) override { type_ = "StitchedMedia"; }
    const std::string& type() const { return type_; }

    static std::string typeOf(const Media& media);

private:
    std::string type_;
};

} // namespace VelaMediaLib
