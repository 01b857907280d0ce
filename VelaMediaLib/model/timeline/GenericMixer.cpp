#include <VelaMediaLib/model/timeline/GenericMixer.h>

namespace VelaMediaLib {

boost::shared_ptr<GenericMixer> GenericMixer::create(const boost::weak_ptr<const ThreadSafe>& token) {
    return boost::shared_ptr<GenericMixer>(new GenericMixer(token));
}

MixerPtr GenericMixer::cloneEmpty() const {
    const boost::shared_ptr<GenericMixer> copy = create(projectMutex());
    copy->setIdentifier(identifier());
    return copy;
}

} // namespace VelaMediaLib
