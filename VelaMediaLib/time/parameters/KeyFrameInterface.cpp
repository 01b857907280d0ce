#include <VelaMediaLib/time/parameters/KeyFrameInterface.h>

#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/ValueFormatter.h>

namespace VelaMediaLib {

KeyFrameInterface::KeyFrameInterface(const boost::weak_ptr<const ThreadSafe>& token,
                                     const RationalTime& endTime, const RationalTime& leadIn)
    : MetaDatable(token), endTime_(endTime), leadIn_(leadIn) {}

RationalTime KeyFrameInterface::endTime() const {
    ScopedReadLock lock(metaDataProjectMutex());
    return endTime_;
}

RationalTime KeyFrameInterface::duration() const {
    ScopedReadLock lock(metaDataProjectMutex());
    return leadIn_;
}

RationalTime KeyFrameInterface::time() const {
    ScopedReadLock lock(metaDataProjectMutex());
    return RationalTime(endTime_.asRational() - leadIn_.asRational());
}

void KeyFrameInterface::toJSON(XMLOptions& options, int level) const {
    ScopedReadLock lock(metaDataProjectMutex());
    JSONWriter object(options, level);
    ValueFormatter<RationalTime>::write(object.key("time"), time());
    ValueFormatter<RationalTime>::write(object.key("endTime"), endTime_);
    writeValue(object.key("value"));
    ValueFormatter<RationalTime>::write(object.key("duration"), leadIn_);
    const std::string interp = interpolaterJson();
    if (!interp.empty()) object.key("interp") << interp;
    MetaDatable::toJSON(object, *this);
}

} // namespace VelaMediaLib
