#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/TextAttributeList.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

namespace VelaMediaLib {

/// A generated clip that shows attributed text. Its text is the keyframed
/// parameter "text" (it only steps: text does not tween), and the boolean
/// attribute "autoRotateText" says whether the text turns with the clip's
/// shape. It has no media extent: its static editor changes only the track
/// range, and it can be extended without limit.
class VELAMEDIALIB_API Callout : public VisualMediaImpl {
public:
    static boost::shared_ptr<Callout> create(const boost::weak_ptr<const ThreadSafe>& token,
                                             const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                                             VelaTime duration,
                                             const TextAttributeList& text = TextAttributeList());

    boost::shared_ptr<Parameter<TextAttributeList>> textParam() const {
        return typedParameter<TextAttributeList>("text");
    }
    /// The text at the clip's parametric time 0.
    TextAttributeList text() const;
    /// Makes the text constant: every text keyframe gives way to this one.
    void setText(const TextAttributeList& text);

    bool autoRotateText() const { return attributeValue("autoRotateText", false); }
    void setAutoRotateText(bool rotate) { addAttribute("autoRotateText", rotate); }

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;

protected:
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override;
    std::vector<std::string> defaultParameterNames() const override;

private:
    Callout(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
            const MediaState& initial)
        : Media(token), VisualMedia(token), VisualMediaImpl(token, rate, initial, Static) {}
};

} // namespace VelaMediaLib
