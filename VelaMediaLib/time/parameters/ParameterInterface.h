#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONValues.h> // declares Json::Value
#include <VelaMediaLib/time/rational/TimeExceptions.h>
#include <VelaMediaLib/time/parameters/Attribute.h>
#include <VelaMediaLib/time/parameters/KeyFrameInterface.h>
#include <VelaMediaLib/time/rational/Range.h>
#include <VelaMediaLib/time/rational/RationalTime.h>
#include <VelaMediaLib/time/sync/Subject.h>
#include <VelaMediaLib/time/rational/TimeScalable.h>

#include <boost/enable_shared_from_this.hpp>
#include <functional>
#include <map>
#include <vector>

namespace VelaMediaLib {

class XMLOptions;

/// The type-independent face of a keyframed parameter, through which
/// documents, commands and dispatchers handle parameters of any value type.
/// Queries take the project's read lock, edits its write lock; observers are
/// told after each edit that changed something. Parameters are held by shared
/// pointer; that pointer is their lifeline.
class VELAMEDIALIB_API ParameterInterface : public Subject,
                                            public boost::enable_shared_from_this<ParameterInterface> {
public:
    explicit ParameterInterface(const boost::weak_ptr<const ThreadSafe>& token) : Subject(token) {}
    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }

    virtual std::string identifier() const = 0;
    virtual boost::shared_ptr<Attribute<std::string>> identAttribute() = 0;
    /// The type name written into documents ("double", "?" for float, ...).
    virtual std::string parameterTypeString() const = 0;

    virtual size_t numKeyFrames() const = 0;
    virtual bool hasKeyFrameAtTime(const RationalTime& time) const = 0;
    /// Whether a keyframe lies in [start, start + duration], both ends included.
    virtual bool hasKeyFrameInRange(const Range<RationalTime>& range) const = 0;
    virtual boost::shared_ptr<std::vector<RationalTime>> keyframeTimes() const = 0;
    /// From the first keyframe (start) to the last (start + duration).
    virtual Range<RationalTime> keyframeRange() const = 0;
    virtual RationalTime firstKeyFrameTime() const = 0;
    /// The first keyframe time after the given time, or that time when there is none.
    virtual RationalTime nextKeyFrameTime(const RationalTime& time) const = 0;
    /// The last keyframe time before the given time, or that time when there is none.
    virtual RationalTime previousKeyFrameTime(const RationalTime& time) const = 0;
    /// True when the values at the two times are not exactly equal.
    virtual bool valuesDifferAtTimes(const RationalTime& a, const RationalTime& b) const = 0;
    virtual boost::shared_ptr<KeyFrameInterface> keyFrameInterfaceAtTime(const RationalTime& time) const = 0;

    /// Whether the value type is a plain scalar (number or text).
    virtual bool isSimpleType() const = 0;
    virtual bool shouldSerialize() const = 0;
    virtual bool hasValueBounds() const = 0;
    virtual bool hasUIHints() const = 0;
    /// The owner's time scale, shared: a parameter may outlive its owner.
    virtual const boost::shared_ptr<const TimeScalable>& timeScalable() const = 0;
    virtual void setTimeScalable(const boost::shared_ptr<const TimeScalable>& scalable) = 0;

    /// Throws KeyFrameException when there is no keyframe at `from` or another stands at `to`.
    virtual void moveKeyFrame(const RationalTime& from, const RationalTime& to) = 0;
    /// Moves every keyframe whose time the predicate selects by the offset; all or none.
    virtual void moveKeyframes(const RationalTime& offset, std::function<bool(RationalTime)> select) = 0;
    /// Returns the lead-in the keyframe had.
    virtual RationalTime changeKeyFrameLeadInLength(const RationalTime& time, const RationalTime& leadIn) = 0;

    virtual boost::shared_ptr<ParameterInterface> cloneParameter() const = 0;
    virtual boost::shared_ptr<ParameterInterface>
    copyPortionInterface(const Range<RationalTime>& range) const = 0;
    /// Gives a clone what it shares with this parameter: its time scale, value
    /// bounds and interface hints.
    virtual void setupSharedClone(const boost::shared_ptr<ParameterInterface>& clone) const = 0;

    /// Writes the parameter, under its name when one is given: as the next
    /// member of the object open in the options (or where the text stands when
    /// none is), closing its own object at indent. A non-empty type name is
    /// written instead of parameterTypeString() (and then the parameter is
    /// never written bare).
    virtual void toJSON(XMLOptions& options, int indent, const std::string& name,
                        const std::string& typeName = std::string()) const = 0;
    /// Reads a bare value or a parameter object into this parameter, all or
    /// nothing. Each "keyframes" entry at an existing keyframe's time replaces
    /// its value; other entries add keyframes (a bare value makes the
    /// parameter constant).
    virtual void readFromJSON(const Json::Value& value) = 0;
    /// Reads a document value as the whole parameter: its entries are read
    /// into a curve without keyframes, so a parameter reads back what this
    /// library wrote of it. All or nothing.
    virtual void replaceFromJSON(const Json::Value& value) = 0;
    /// A new parameter of this kind that has read the document value as
    /// replaceFromJSON would; this parameter does not change. Throws as the
    /// reading does.
    virtual boost::shared_ptr<ParameterInterface> readCopyFromJSON(const Json::Value& value) const = 0;
    /// Takes over what such a copy holds, staying the same object (so whoever
    /// holds or observes it keeps it). Runs under the write lock and tells
    /// nobody: the caller notifies. Returns false, changing nothing, when the
    /// copy is of another kind.
    virtual bool takeStateOf(ParameterInterface& copy) = 0;

    /// The parameter's own metadata (made on first use, taking the read lock only).
    virtual MetaDatable* metaDataPtr() = 0;
    virtual std::map<std::string, std::string> generateMetaDataMap() const = 0;
};

} // namespace VelaMediaLib
