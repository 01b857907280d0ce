#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONValues.h>

#include <boost/rational.hpp>
#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>
#include <memory>
#include <string>
#include <unordered_map>
#include <unordered_set>
#include <vector>

namespace VelaMediaLib {

class ChangedFileHandler;
class Media;
class MediaReader;
class MetaDatable;
class MissingFileHandler;
class Project;
class Source;
class SubTimeline;
class Timeline;
class VisualMedia;

/// What the readers of one load share: the project being built, the objects
/// read so far by their document "id", and the hotspots whose marker targets
/// are resolved once every object exists. Only the load that made it uses it.
struct VELAMEDIALIB_API ReadContext {
    boost::shared_ptr<Project> project;
    boost::shared_ptr<MissingFileHandler> missingFileHandler;
    boost::shared_ptr<ChangedFileHandler> changedFileHandler;
    std::unordered_map<long long, boost::shared_ptr<Source>> sources;
    std::unordered_map<long long, boost::shared_ptr<Media>> medias;
    /// Every id taken, sources, media and the timeline alike.
    std::unordered_set<long long> ids;
    long long timelineId = 0;
    bool hasTimelineId = false;
    /// Media whose hotspot names a marker target, with that target's id.
    std::vector<std::pair<boost::weak_ptr<VisualMedia>, long long>> hotspots;
    /// How many composite clips the reader is inside.
    int depth = 0;
    /// Set by a parser that owns a tree it no longer needs once read: each
    /// track's subtree is let go as soon as the track is built.
    bool releaseTracks = false;
    /// Whether source files are looked at (see SourceBinReader).
    bool checkFiles = true;

    /// Records the id; throws "Invalid project json - duplicate id: N".
    void takeId(long long id);
};

/// The deepest composite nesting a document may have.
constexpr int kMaxReadNesting = 64;

/// The base of the project document readers and the conversions they share.
/// A reader holds the load's context and the value of the object it reads;
/// `read` builds the object, or throws ParserException naming what was
/// wrong ("Invalid project json - ..."). Members are accepted in any order.
class VELAMEDIALIB_API JSONReader {
public:
    explicit JSONReader(const boost::shared_ptr<ReadContext>& context = {});
    virtual ~JSONReader();

    /// Reads the object; true when it was read.
    virtual bool read(const Json::Value& value) = 0;

    /// The conversions every reader shares (see JSONValues.h).
    static SafeRational jsonValueAsVelaRational(const Json::Value& value) {
        return VelaMediaLib::jsonValueAsVelaRational(value);
    }
    static RationalTime jsonValueAsRationalTime(const Json::Value& value) {
        return VelaMediaLib::jsonValueAsRationalTime(value);
    }
    static long long jsonValueAsVelaTime(const Json::Value& value) {
        return VelaMediaLib::jsonValueAsVelaTime(value);
    }
    static SafeRational asRational(const Json::Value& value) { return jsonValueAsVelaRational(value); }
    static long long asLongLong(const Json::Value& value) { return jsonValueAsVelaTime(value); }

    static const char* idTagName() { return "id"; }
    static const char* parametersTagName() { return "parameters"; }

    /// Fills the object's metadata from the value's "metadata" member, if any.
    static void readMetaData(const Json::Value& value, MetaDatable& object);
    /// Reads the media object's "sourceEffect" (with its "parameters") onto the media, if any.
    static void readSourceEffect(const Json::Value& value, Media& media);
    /// The reader of the media object's "_type" (exact, case-sensitive), or
    /// null for an unknown or missing kind: no media is built for it.
    static std::unique_ptr<MediaReader>
    mediaReaderForJsonValue(const Json::Value& value, const boost::shared_ptr<ReadContext>& context);

    const boost::shared_ptr<ReadContext>& readContext() const { return context_; }

protected:
    ReadContext& context() const { return *context_; }
    /// The object being read (set by read), or null.
    const Json::Value* value() const { return value_; }
    void setValue(const Json::Value& value) { value_ = &value; }

private:
    boost::shared_ptr<ReadContext> context_;
    const Json::Value* value_ = nullptr;
};

/// Throws ParserException "Invalid project json - " and the text.
[[noreturn]] VELAMEDIALIB_API void refuseDocument(const std::string& what);

} // namespace VelaMediaLib
