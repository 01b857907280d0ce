#pragma once
// The one implementation of keyframed parameters.
//
// Choices where the behaviour is ours to set:
// - A keyframe may stand at a time when its lead-in is not negative, its
//   transition does not start before the previous keyframe, and it does not
//   fall inside the lead-in of the next one.
// - New keyframes follow the parameter's default interpolater (an empty
//   reference on the keyframe); interpolaterForKeyFrame resolves it.
// - The only keyframe cannot be removed: a queried parameter always has one.
// - Value bounds and interface hints describe the parameter to a user
//   interface; values outside the bounds are stored as given.
// - copyPortion keeps the keyframes inside the range and, for an animated
//   parameter, adds keyframes at the range's edges holding the values there.
// - The identifier attribute and the metadata are made on first use under the
//   read lock (published with one compare-and-swap), so asking for them never
//   takes the write lock; what they add to a constant parameter's document
//   form counts only when it holds something.

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>
#include <VelaMediaLib/time/parameters/KeyFrameMapUtil.h>
#include <VelaMediaLib/time/sync/LazyCreation.h>
#include <VelaMediaLib/time/parameters/Parameter.h>
#include <VelaMediaLib/time/parameters/ValueTraits.h>

#include <boost/optional.hpp>
#include <memory>
#include <set>
#include <sstream>
#include <type_traits>
#include <typeinfo>

namespace VelaMediaLib {

/// The minimum, maximum and default a user interface offers for a parameter.
template <typename T>
struct VELAMEDIALIB_TEMPLATE_API ValueBounds {
    T minValue, maxValue, defaultValue;
};

/// How a user interface presents a parameter: its control and its unit.
struct VELAMEDIALIB_API UIHints {
    std::string userInterfaceType;
    std::string unitType;
};

template <typename T>
class VELAMEDIALIB_TEMPLATE_API ParameterImpl : public Parameter<T> {
public:
    typedef Parameter<T> Base;
    typedef typename Base::KeyFramePtr KeyFramePtr;
    typedef typename Base::ConstKeyFramePtr ConstKeyFramePtr;
    typedef typename Base::InterpolaterPtr InterpolaterPtr;
    typedef KeyFrameMapUtil<KeyFrame<T>> MapUtil;
    typedef typename MapUtil::Map KeyFrameMap;

    ParameterImpl(
        const boost::weak_ptr<const ThreadSafe>& token, const std::string& identifier,
        const boost::shared_ptr<const TimeScalable>& scalable = boost::shared_ptr<const TimeScalable>())
        : Base(token), identifier_(identifier), scalable_(scalable) {}
    /// A deep copy: keyframes are cloned, observers are not carried over.
    ParameterImpl(const ParameterImpl& other);

    /// A parameter holding the value as its only keyframe, at time 0.
    static boost::shared_ptr<ParameterImpl>
    create(const boost::weak_ptr<const ThreadSafe>& token, const std::string& identifier, const T& value,
           const boost::shared_ptr<const TimeScalable>& scalable = boost::shared_ptr<const TimeScalable>()) {
        return createHolding<ParameterImpl>(value, token, identifier, scalable);
    }

    // Identification and description
    std::string identifier() const override;
    /// Made on first use under the read lock only.
    boost::shared_ptr<Attribute<std::string>> identAttribute() override;
    std::string parameterTypeString() const override { return ValueTraits<T>::typeName(); }
    bool isSimpleType() const override {
        return std::is_arithmetic<T>::value || std::is_same<T, std::string>::value;
    }
    bool shouldSerialize() const override { return true; }
    bool hasValueBounds() const override;
    bool hasUIHints() const override;
    boost::optional<ValueBounds<T>> valueBounds() const;
    void setValueBounds(const T& minValue, const T& maxValue, const T& defaultValue);
    boost::optional<UIHints> uiHints() const;
    void setUIHints(const std::string& userInterfaceType, const std::string& unitType);
    const boost::shared_ptr<const TimeScalable>& timeScalable() const override { return scalable_; }
    void setTimeScalable(const boost::shared_ptr<const TimeScalable>& scalable) override {
        scalable_ = scalable;
    }
    /// Made on first use under the read lock only; stays the same object for
    /// the parameter's life (reading a document replaces its entries).
    MetaDatable* metaDataPtr() override;
    std::map<std::string, std::string> generateMetaDataMap() const override;

    // Queries
    T valueAtTime(const RationalTime& time) const override;
    size_t numKeyFrames() const override;
    KeyFramePtr keyframeAtTime(const RationalTime& time) override;
    ConstKeyFramePtr keyframeAtTime(const RationalTime& time) const override;
    boost::shared_ptr<KeyFrameInterface> keyFrameInterfaceAtTime(const RationalTime& time) const override;
    bool hasKeyFrameAtTime(const RationalTime& time) const override;
    bool hasKeyFrameInRange(const Range<RationalTime>& range) const override;
    boost::shared_ptr<std::vector<RationalTime>> keyframeTimes() const override;
    Range<RationalTime> keyframeRange() const override;
    RationalTime firstKeyFrameTime() const override;
    RationalTime nextKeyFrameTime(const RationalTime& time) const override;
    RationalTime previousKeyFrameTime(const RationalTime& time) const override;
    bool valuesDifferAtTimes(const RationalTime& a, const RationalTime& b) const override;
    InterpolaterPtr interpolaterForKeyFrame(const ConstKeyFramePtr& keyframe) const override;
    bool operator==(const Parameter<T>& other) const override;

    // Edits
    T setDefaultValue(const T& value) override;
    T setValueAtTime(const T& value, const RationalTime& time) override;
    void addKeyFrame(const RationalTime& time, const T& value, const RationalTime& leadIn) override;
    void addKeyFrame(const KeyFramePtr& keyframe) override;
    KeyFramePtr removeKeyFrame(const RationalTime& time) override;
    T changeKeyFrame(const RationalTime& time, const T& value) override;
    T changeKeyFrame(const ConstKeyFramePtr& keyframe, const T& value) override;
    KeyFramePtr changeKeyFrame(const RationalTime& time, const KeyFramePtr& keyframe) override;
    RationalTime changeKeyFrameLeadInLength(const RationalTime& time, const RationalTime& leadIn) override;
    void moveKeyFrame(const RationalTime& from, const RationalTime& to) override;
    void moveKeyframes(const RationalTime& offset, std::function<bool(RationalTime)> select) override;

    // Copies
    boost::shared_ptr<ParameterInterface> cloneParameter() const override { return clone(); }
    boost::shared_ptr<ParameterImpl> clone() const {
        return boost::static_pointer_cast<ParameterImpl>(cloneImpl());
    }
    boost::shared_ptr<Parameter<T>> copyPortion(const Range<RationalTime>& range) const override;
    boost::shared_ptr<ParameterInterface>
    copyPortionInterface(const Range<RationalTime>& range) const override {
        return copyPortion(range);
    }
    void setupSharedClone(const boost::shared_ptr<ParameterInterface>& clone) const override;

    // Document
    void toJSON(XMLOptions& options, int indent, const std::string& name,
                const std::string& typeName = std::string()) const override;
    void readFromJSON(const Json::Value& value) override;
    void replaceFromJSON(const Json::Value& value) override;
    boost::shared_ptr<ParameterInterface> readCopyFromJSON(const Json::Value& value) const override {
        return readScratch(value, true);
    }
    bool takeStateOf(ParameterInterface& copy) override;
    /// Names of parameters that are always written as objects, never bare.
    static std::set<std::string>& namesWrittenInFull() {
        static std::set<std::string> names;
        return names;
    }

protected:
    /// A new parameter of a kind, holding the value as its only keyframe at
    /// time 0. Nothing else knows it yet, so it takes no lock: parameters are
    /// made on first use inside readers' snapshots.
    template <typename Kind, typename... Args>
    static boost::shared_ptr<Kind> createHolding(const T& value, Args&&... args) {
        boost::shared_ptr<Kind> parameter(new Kind(std::forward<Args>(args)...));
        ParameterImpl& made = *parameter;
        made.keyframes_.push_back(
            {RationalTime(0), made.newKeyFrame(RationalTime(0), value, RationalTime(0))});
        return parameter;
    }

    /// A copy of the same kind; kinds with state of their own override it.
    virtual boost::shared_ptr<ParameterImpl> cloneImpl() const {
        return boost::shared_ptr<ParameterImpl>(new ParameterImpl(*this));
    }
    /// The interpolater of keyframes that have none of their own.
    virtual const InterpolaterPtr& defaultInterpolater() const {
        return InterpolaterFactory<T>::defaultInterpolater();
    }
    /// The interpolater of the segment that ends at the keyframe. Both answer
    /// references: queries on many threads must not count the shared
    /// interpolaters' owners up and down.
    virtual const InterpolaterPtr& segmentInterpolater(const KeyFrame<T>& end) const {
        return end.interpolater_ ? end.interpolater_ : defaultInterpolater();
    }
    /// The parameter's own "interp" in its document object, or empty.
    virtual std::string parameterInterpolaterName() const { return std::string(); }
    virtual void readParameterInterpolater(const std::string&) {}
    /// Whether a keyframe may stand at the time with the lead-in; `ignoring`
    /// is a keyframe that is being moved and does not count.
    virtual bool canAddKeyFrame(const RationalTime& time, const RationalTime& leadIn,
                                const KeyFrame<T>* ignoring = nullptr) const;
    /// Called under the write lock after every edit that changed the keyframes.
    virtual void keyframesEdited() {}
    /// The lead-in of the keyframe copyPortion adds at the range's end, given
    /// the length of the segment it ends (a lead-in of 0 and one of the whole
    /// segment give the same values).
    virtual RationalTime edgeLeadIn(const RationalTime&) const { return RationalTime(0); }
    /// Cuts every lead-in that reaches back past the previous keyframe to
    /// start at it (which gives the same values).
    static void cutLeadInsToTheirSegments(KeyFrameMap& curve) {
        for (size_t i = 1; i < curve.size(); ++i) {
            const RationalTime segment = curve[i].time - curve[i - 1].time;
            if (curve[i].keyframe->leadIn_ > segment) curve[i].keyframe->leadIn_ = segment;
        }
    }
    /// Reads one keyframe object of a document's "keyframes" array into this parameter.
    virtual void readKeyFrame(const Json::Value& keyframe);
    /// Puts a keyframe read from a document at its end time: an existing one
    /// takes the value, otherwise one is added. Returns the keyframe, or null
    /// when the kind took the value without a keyframe.
    virtual KeyFramePtr placeReadKeyFrame(const RationalTime& end, const T& value,
                                          const RationalTime& leadIn);
    /// Adopts what a scratch copy read from a document; kinds with state of
    /// their own take theirs too.
    virtual void takeStateFrom(ParameterImpl& read);
    /// Empties a scratch copy's curve and metadata before a whole parameter
    /// is read into it; kinds with a curve of their own empty theirs too.
    virtual void clearForReading();
    /// A copy of this parameter that has read the document value, from no
    /// keyframes or from this parameter's curve.
    boost::shared_ptr<ParameterImpl> readScratch(const Json::Value& json, bool fromNoKeyFrames) const;
    void readDocument(const Json::Value& json, bool fromNoKeyFrames);
    void readInto(const Json::Value& json);
    /// Whether the parameter is written as its bare value: it is written under
    /// its own type name, its name is not one always written in full, and it
    /// holds nothing but one plain keyframe at time 0 with no bounds or hints.
    virtual bool writtenBare(const std::string& name, const std::string& typeName) const;
    /// Writes the curve: "keyframes", or what a kind writes in its place, as
    /// members of the parameter's object (which stand at indent).
    virtual void writeKeyFrames(XMLOptions& options, int indent) const;
    virtual void readKeyFrames(const Json::Value& object);

    // Unlocked helpers: callers hold the project lock.
    T valueAtTimeLocked(const RationalTime& time) const;
    KeyFramePtr exactKeyFrame(const RationalTime& time) const;
    KeyFramePtr exactKeyFrameOrThrow(const RationalTime& time, const char* operation) const;
    KeyFramePtr newKeyFrame(const RationalTime& time, const T& value, const RationalTime& leadIn) const {
        return KeyFramePtr(new KeyFrame<T>(this->projectMutex(), time, value, leadIn));
    }
    /// Whether every keyframe of the curve stands where canAddKeyFrame allows.
    bool placementHolds(KeyFrameMap& curve);
    [[noreturn]] void refuse(const std::string& what, const RationalTime& time) const {
        throw KeyFrameException(what + " at time " + describe(time) + " in parameter " + identifier_, time,
                                identifier_);
    }
    static std::string describe(const RationalTime& time) {
        std::ostringstream out;
        out << time;
        return out.str();
    }
    /// Runs a change under the write lock, then tells the observers.
    template <typename Change>
    void edit(Change change) {
        {
            ScopedWriteLock lock(this->projectMutex());
            change();
            keyframesEdited();
        }
        this->notify();
    }

    KeyFrameMap keyframes_;

private:
    // What few parameters have, allocated when first needed. Bounds and hints
    // change under the write lock; the attribute and the metadata are made on
    // first use by queries.
    struct Extras {
        boost::optional<ValueBounds<T>> bounds;
        boost::optional<UIHints> hints;
        LazyPtr<boost::shared_ptr<Attribute<std::string>>> identAttribute;
        LazyPtr<MetaDatable> metadata;
    };
    Extras& extras() const {
        return extras_.getOrMake([] { return new Extras; });
    }
    MetaDatable& metadata() const;
    /// Whether bounds, hints or metadata entries need the document's object form.
    bool describedBeyondTheCurve() const;
    static void writeBounds(XMLOptions& options, int indent, const ValueBounds<T>& bounds);

    std::string identifier_;
    boost::shared_ptr<const TimeScalable> scalable_;
    LazyPtr<Extras> extras_;
};

} // namespace VelaMediaLib

#include <VelaMediaLib/time/parameters/detail/ParameterImplQueries.h>
#include <VelaMediaLib/time/parameters/detail/ParameterImplEdits.h>

// Built once in the library for every value type.
namespace VelaMediaLib {
#define VELA_EXTERN_PARAMETER(Type) extern template class VELAMEDIALIB_EXTERN_TEMPLATE ParameterImpl<Type>;
VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_EXTERN_PARAMETER)
#undef VELA_EXTERN_PARAMETER
} // namespace VelaMediaLib
