#include <VelaMediaLib/time/parameters/KeyFrameInterface.h>

#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/JSONValues.h>

namespace VelaMediaLib {

KeyFrameInterface::KeyFrameInterface(const boost::weak_ptr<const ThreadSafe>& token,
                                     const RationalTime& endTime, const RationalTime& leadIn)
    : MetaDatable(token), endTime_(endTime), leadIn_(leadIn) {}

RationalTime KeyFrameInterface::endTime() const {
    ScopedReadLock lock(this->projectLock());
    return endTime_;
}

RationalTime KeyFrameInterface::duration() const {
    ScopedReadLock lock(this->projectLock());
    return leadIn_;
}

RationalTime KeyFrameInterface::time() const {
    ScopedReadLock lock(this->projectLock());
    return RationalTime(endTime_.asRational() - leadIn_.asRational());
}

void KeyFrameInterface::toJSON(XMLOptions& options, int indent) const {
    ScopedReadLock lock(this->projectLock());
    JSONWriter object(options, indent);
    const int members = object.memberLevel();
    options.key("time");
    writeJSONValue(options, members, time());
    options.key("endTime");
    writeJSONValue(options, members, endTime_);
    options.key("value");
    writeValue(options, members);
    options.key("duration");
    writeJSONValue(options, members, leadIn_);
    const std::string interp = interpolaterJson();
    if (!interp.empty()) options.key("interp") << interp;
    MetaDatable::toJSON(options, members, *this);
}

} // namespace VelaMediaLib
