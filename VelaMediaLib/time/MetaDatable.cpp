#include <VelaMediaLib/time/MetaDatable.h>

namespace VelaMediaLib {

MetaDatable::MetaDatable(const boost::weak_ptr<const ThreadSafe>& token) : token_(token) {}

MetaDatable::AttributePtr MetaDatable::addMetaData(const std::string& key, const std::string& value) {
    AttributePtr attribute;
    {
        ScopedWriteLock lock(token_);
        AttributePtr& slot = metaData_[key];
        if (!slot) {
            slot.reset(new Attribute<std::string>(key, value, token_));
            return slot;
        }
        attribute = slot;
    }
    attribute->setValue(value);
    return attribute;
}

MetaDatable::AttributePtr MetaDatable::metaDataAttribute(const std::string& key) const {
    ScopedReadLock lock(token_);
    const auto found = metaData_.find(key);
    return found == metaData_.end() ? AttributePtr() : found->second;
}

std::string MetaDatable::metaDataValue(const std::string& key) const {
    const AttributePtr attribute = metaDataAttribute(key);
    return attribute ? attribute->value() : std::string();
}

bool MetaDatable::hasMetaData(const std::string& key) const { return bool(metaDataAttribute(key)); }

bool MetaDatable::removeMetaData(const std::string& key) {
    ScopedWriteLock lock(token_);
    return metaData_.erase(key) > 0;
}

std::vector<std::string> MetaDatable::metaDataKeys() const {
    ScopedReadLock lock(token_);
    std::vector<std::string> keys;
    for (const auto& entry : metaData_) keys.push_back(entry.first);
    return keys;
}

void MetaDatable::setMetaDataToken(const boost::weak_ptr<const ThreadSafe>& token) {
    ScopedWriteLock lock(token_);
    token_ = token;
    for (auto& entry : metaData_) entry.second->setProjectMutex(token);
}

} // namespace VelaMediaLib
