#include <VelaMediaLib/model/media/Callout.h>

#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/time/parameters/LeftParameter.h>

namespace VelaMediaLib {

boost::shared_ptr<Callout> Callout::create(const boost::weak_ptr<const ThreadSafe>& token,
                                           const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                                           VelaTime duration, const TextAttributeList& text) {
    const MediaState state = MediaState::unbounded(start, duration);
    const boost::shared_ptr<Callout> media(new Callout(token, rate, state));
    media->addAttribute("autoRotateText", false);
    if (text != TextAttributeList()) media->setText(text);
    return media;
}

std::vector<std::string> Callout::defaultParameterNames() const {
    std::vector<std::string> names = VisualMediaImpl::defaultParameterNames();
    names.push_back("text");
    return names;
}

boost::shared_ptr<ParameterInterface> Callout::createDefaultParameter(const std::string& name) const {
    if (name != "text") return VisualMediaImpl::createDefaultParameter(name);
    return LeftParameter<TextAttributeList>::create(projectMutex(), name, TextAttributeList(),
                                                    sharedTimeScale());
}

// Reads without making the parameter: a callout never given text answers empty text.
TextAttributeList Callout::text() const {
    return parameterValueAtTime("text", RationalTime(0), TextAttributeList());
}

void Callout::setText(const TextAttributeList& text) { textParam()->setDefaultValue(text); }

boost::shared_ptr<Media> Callout::clone() const {
    const boost::shared_ptr<Callout> copy(new Callout(projectMutex(), projectEditRate(), state()));
    copyContentInto(*copy);
    return copy;
}

void Callout::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchCallout(*this); }
void Callout::dispatch(ConstMediaDispatcher& dispatcher) const { dispatcher.dispatchCallout(*this); }

} // namespace VelaMediaLib
