#include <VelaMediaLib/time/parameters/MetaDatable.h>

#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <json/value.h>

namespace VelaMediaLib {

MetaDatable::MetaDatable(const boost::weak_ptr<const ThreadSafe>& token) { recordProjectToken(token); }

MetaDatable::AttributePtr MetaDatable::addMetaData(const std::string& key, const std::string& value) {
    AttributePtr attribute;
    {
        ScopedWriteLock lock(projectMutex());
        if (!metaData_) metaData_.reset(new Map);
        AttributePtr& slot = (*metaData_)[key];
        if (!slot) {
            slot.reset(new Attribute<std::string>(key, value, projectMutex()));
            return slot;
        }
        attribute = slot;
    }
    attribute->setValue(value);
    return attribute;
}

MetaDatable::AttributePtr MetaDatable::metaDataAttribute(const std::string& key) const {
    ScopedReadLock lock(projectLock());
    if (!metaData_) return AttributePtr();
    const auto found = metaData_->find(key);
    return found == metaData_->end() ? AttributePtr() : found->second;
}

std::string MetaDatable::metaDataValue(const std::string& key) const {
    const AttributePtr attribute = metaDataAttribute(key);
    return attribute ? attribute->value() : std::string();
}

bool MetaDatable::hasMetaData(const std::string& key) const { return bool(metaDataAttribute(key)); }

bool MetaDatable::removeMetaData(const std::string& key) {
    ScopedWriteLock lock(projectMutex());
    return metaData_ && metaData_->erase(key) > 0;
}

std::vector<std::string> MetaDatable::metaDataKeys() const {
    ScopedReadLock lock(projectLock());
    std::vector<std::string> keys;
    if (metaData_)
        for (const auto& entry : *metaData_) keys.push_back(entry.first);
    return keys;
}

// Null once the project has gone: edits there take no lock, so a caller that
// holds this one must not be taken for a writer.
ReadWriteMutex* MetaDatable::metaDataMutex() const {
    return projectMutex().expired() ? nullptr : projectLock();
}

void MetaDatable::setMetaDataProjectMutex(const boost::weak_ptr<const ThreadSafe>& token) {
    ScopedWriteLock lock(projectMutex());
    replaceProjectToken(token);
    if (metaData_)
        for (auto& entry : *metaData_) entry.second->setProjectMutex(token);
}

std::map<std::string, std::string> MetaDatable::metaDataCopy() const {
    ScopedReadLock lock(projectLock());
    std::map<std::string, std::string> copy;
    if (metaData_)
        for (const auto& entry : *metaData_) copy[entry.first] = entry.second->value();
    return copy;
}

void MetaDatable::toJSON(XMLOptions& options, int indent, const MetaDatable& object) {
    const std::map<std::string, std::string> entries = object.metaDataCopy();
    if (entries.empty()) return;
    options.key("metadata");
    JSONWriter members(options, indent);
    for (const auto& entry : entries) {
        options.key(entry.first);
        writeJSONValue(options, members.memberLevel(), entry.second);
    }
}

void MetaDatable::readFromJSON(const Json::Value& value, MetaDatable& object) {
    const Json::Value& metadata = value["metadata"];
    if (!metadata.isObject()) return;
    for (const std::string& key : metadata.getMemberNames())
        object.addMetaData(key,
                           metadata[key].isString() ? metadata[key].asString() : compactJSON(metadata[key]));
}

} // namespace VelaMediaLib
