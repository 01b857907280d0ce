#include <VelaMediaLib/model/media/Caption.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/model/media/MediaDispatcher.h>
#include <VelaMediaLib/time/parameters/LeftParameter.h>

namespace VelaMediaLib {

constexpr long long Caption::kNoMaxMediaDuration;

boost::shared_ptr<Caption> Caption::create(const boost::weak_ptr<const ThreadSafe>& token,
                                           const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                                           VelaTime duration, const CaptionData& caption) {
    const MediaState state = MediaState::unbounded(start, duration);
    const boost::shared_ptr<Caption> media(new Caption(token, rate, state));
    if (caption != CaptionData()) media->setCaption(caption);
    return media;
}

std::vector<std::string> Caption::defaultParameterNames() const {
    std::vector<std::string> names = VisualMediaImpl::defaultParameterNames();
    names.push_back("caption");
    return names;
}

boost::shared_ptr<ParameterInterface> Caption::createDefaultParameter(const std::string& name) const {
    if (name != "caption") return VisualMediaImpl::createDefaultParameter(name);
    return LeftParameter<CaptionData>::create(projectMutex(), name, CaptionData(), sharedTimeScale());
}

CaptionData Caption::captionAtTime(const RationalTime& time) const {
    return parameterValueAtTime("caption", time, CaptionData());
}

void Caption::setCaption(const CaptionData& caption) { captionParam()->setDefaultValue(caption); }

long long Caption::maxMediaDuration() const {
    ScopedReadLock lock(projectLock());
    return maxMediaDuration_;
}

void Caption::setMaxMediaDuration(long long ticks) {
    if (ticks <= 0)
        throw ValueException<long long>("caption max media duration must be greater than 0", ticks);
    {
        ScopedWriteLock lock(projectMutex());
        if (maxMediaDuration_ == ticks) return;
        maxMediaDuration_ = ticks;
    }
    notify();
}

bool Caption::allowTrimOut() const {
    ScopedReadLock lock(projectLock());
    return allowTrimOut_;
}

void Caption::setAllowTrimOut(bool allow) {
    {
        ScopedWriteLock lock(projectMutex());
        if (allowTrimOut_ == allow) return;
        allowTrimOut_ = allow;
    }
    notify();
}

boost::shared_ptr<Media> Caption::clone() const {
    const boost::shared_ptr<Caption> copy(new Caption(projectMutex(), projectEditRate(), state()));
    copyContentInto(*copy);
    ScopedReadLock lock(projectLock());
    copy->maxMediaDuration_ = maxMediaDuration_;
    copy->allowTrimOut_ = allowTrimOut_;
    return copy;
}

void Caption::dispatch(MediaDispatcher& dispatcher) { dispatcher.dispatchCaption(*this); }
void Caption::dispatch(ConstMediaDispatcher& dispatcher) const { dispatcher.dispatchCaption(*this); }

void Caption::toJSONSpecificProperties(XMLOptions& options, int indent) const {
    options.key("maxMediaDuration");
    writeJSONValue(options, indent, maxMediaDuration());
    options.key("allowTrimOut");
    writeJSONValue(options, indent, allowTrimOut());
}

} // namespace VelaMediaLib
