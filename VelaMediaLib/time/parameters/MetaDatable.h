#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/parameters/Attribute.h>
#include <VelaMediaLib/time/sync/ProjectToken.h>

#include <boost/shared_ptr.hpp>
#include <map>
#include <memory>
#include <string>
#include <vector>

namespace VelaMediaLib {

class XMLOptions;

/// String metadata of an object: each key holds an observable attribute.
/// Reads and writes take the project lock through the object's token.
class VELAMEDIALIB_API MetaDatable : public virtual ProjectToken {
public:
    typedef boost::shared_ptr<Attribute<std::string>> AttributePtr;

    explicit MetaDatable(
        const boost::weak_ptr<const ThreadSafe>& token = boost::weak_ptr<const ThreadSafe>());
    virtual ~MetaDatable() = default;

    /// Adds the key, or sets the value of the attribute it already has; returns the attribute.
    AttributePtr addMetaData(const std::string& key, const std::string& value);
    /// The attribute of the key, or an empty pointer.
    AttributePtr metaDataAttribute(const std::string& key) const;
    /// The text of the key, or the empty text when it has none.
    std::string metaDataValue(const std::string& key) const;
    bool hasMetaData(const std::string& key) const;
    /// Returns whether the key was there.
    bool removeMetaData(const std::string& key);
    std::vector<std::string> metaDataKeys() const;

    /// The project's token that guards the metadata (the object's one token,
    /// projectMutex()), and the lock it leads to (null once the project has gone).
    const boost::weak_ptr<const ThreadSafe>& metaDataProjectMutex() const { return projectMutex(); }
    ReadWriteMutex* metaDataMutex() const;
    /// Sets the token of the whole object and of its metadata attributes, for
    /// an object being built: parameters and attributes already made keep
    /// the token they were made with.
    void setMetaDataProjectMutex(const boost::weak_ptr<const ThreadSafe>& token);

    /// Writes the keys as the "metadata" member of the object being written
    /// (whose members stand at indent), when there are any.
    static void toJSON(XMLOptions& options, int indent, const MetaDatable& object);
    /// Fills the object's metadata from the "metadata" member of the value, if any.
    static void readFromJSON(const Json::Value& value, MetaDatable& object);
    /// A copy of the keys and values, for cloning.
    std::map<std::string, std::string> metaDataCopy() const;

private:
    typedef std::map<std::string, AttributePtr> Map;
    std::unique_ptr<Map> metaData_; // allocated with the first key: most objects carry none
};

} // namespace VelaMediaLib
