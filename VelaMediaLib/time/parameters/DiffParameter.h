#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>

#include <set>

namespace VelaMediaLib {

/// A parameter expressed as a difference from a source parameter: its own
/// keyframes ("edits", which override the source's at the same time), the
/// source keyframe times it drops ("deletions"), and whether it ignores the
/// source altogether. Its curve is the source's with the difference applied,
/// and follows the source when the source changes. Any edit made through the
/// parameter's operations is kept as a difference.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API DiffParameter : public ParameterImpl<T> {
public:
    typedef ParameterImpl<T> Base;
    typedef typename Base::KeyFrameMap KeyFrameMap;
    typedef typename Base::MapUtil MapUtil;

    DiffParameter(
        const boost::weak_ptr<const ThreadSafe>& token, const std::string& identifier,
        const boost::shared_ptr<Parameter<T>>& source,
        const boost::shared_ptr<const TimeScalable>& scalable = boost::shared_ptr<const TimeScalable>())
        : Base(token, identifier, scalable), source_(source), sourceObserver_(*this) {
        if (source_) source_->attach(&sourceObserver_);
        rebuild();
    }
    DiffParameter(const DiffParameter& other)
        : Base(other), source_(other.source_), edits_(cloneAll(other.edits_)), deletions_(other.deletions_),
          ignoreSource_(other.ignoreSource_), sourceObserver_(*this) {
        if (source_) source_->attach(&sourceObserver_);
    }
    ~DiffParameter() override {
        if (source_) source_->detach(&sourceObserver_);
    }

    static boost::shared_ptr<DiffParameter> create(const boost::weak_ptr<const ThreadSafe>& token,
                                                   const std::string& identifier,
                                                   const boost::shared_ptr<Parameter<T>>& source) {
        return boost::shared_ptr<DiffParameter>(new DiffParameter(token, identifier, source));
    }

    boost::shared_ptr<Parameter<T>> source() const { return source_; }
    bool ignoreSource() const {
        ScopedReadLock lock(this->projectLock());
        return ignoreSource_;
    }
    void setIgnoreSource(bool ignore) {
        this->edit([&] {
            ignoreSource_ = ignore;
            rebuild();
        });
    }
    /// Times of this parameter's own keyframes.
    std::vector<RationalTime> editTimes() const {
        ScopedReadLock lock(this->projectLock());
        std::vector<RationalTime> times;
        for (const auto& entry : edits_) times.push_back(entry.time);
        return times;
    }
    std::set<RationalTime> deletions() const {
        ScopedReadLock lock(this->projectLock());
        return deletions_;
    }
    /// Recomputes the curve from the source; the source's changes call it.
    void refreshFromSource() {
        this->edit([&] { rebuild(); });
    }

protected:
    boost::shared_ptr<Base> cloneImpl() const override {
        return boost::shared_ptr<Base>(new DiffParameter(*this));
    }
    void keyframesEdited() override { recomputeDifference(); }
    bool writtenBare(const std::string&, const std::string&) const override { return false; }

    void writeKeyFrames(XMLOptions& options, int indent) const override {
        options.key("edits");
        {
            JSONWriter edits(options, indent, JSONWriter::Array);
            for (const auto& entry : edits_) {
                options.element();
                writeEdit(options, edits.memberLevel(), entry.time, *entry.keyframe);
            }
        }
        options.key("deletions");
        {
            JSONWriter deletions(options, indent, JSONWriter::Array);
            for (const RationalTime& time : deletions_) {
                options.element();
                writeJSONValue(options, deletions.memberLevel(), time);
            }
        }
        options.key("ignoreSource");
        writeJSONValue(options, indent, ignoreSource_);
    }

    static void writeEdit(XMLOptions& options, int indent, const RationalTime& time,
                          const KeyFrame<T>& edit) {
        JSONWriter object(options, indent);
        const int members = object.memberLevel();
        options.key("time");
        writeJSONValue(options, members, time);
        options.key("value");
        ValueTraits<T>::write(options, members, edit.value());
        if (edit.duration() != RationalTime(0)) {
            options.key("duration");
            writeJSONValue(options, members, edit.duration());
        }
        if (!edit.interpolaterName().empty()) options.key("interp") << edit.interpolater()->asJson();
    }

    void readKeyFrames(const Json::Value& json) override; // detail/DiffParameterDocument.h

    void takeStateFrom(Base& read) override {
        Base::takeStateFrom(read);
        DiffParameter& other = static_cast<DiffParameter&>(read);
        edits_.swap(other.edits_);
        deletions_.swap(other.deletions_);
        ignoreSource_ = other.ignoreSource_;
    }

private:
    struct SourceObserver : Observer {
        explicit SourceObserver(DiffParameter& owner_) : owner(owner_) {}
        void update(Observable*) override { owner.refreshFromSource(); }
        DiffParameter& owner;
    };

    static KeyFrameMap cloneAll(const KeyFrameMap& map) {
        KeyFrameMap copy;
        for (const auto& entry : map) copy.push_back({entry.time, entry.keyframe->clone()});
        return copy;
    }

    KeyFrameMap sourceKeyFrames() const {
        KeyFrameMap keyframes;
        if (!source_ || ignoreSource_) return keyframes;
        const boost::shared_ptr<std::vector<RationalTime>> times = source_->keyframeTimes();
        for (const RationalTime& time : *times)
            keyframes.push_back({time, source_->keyframeAtTime(time)->clone()});
        return keyframes;
    }

    // The curve: the source's keyframes less the deletions, with the edits on
    // top. An edit's lead-in that would now reach back past a keyframe of the
    // source is cut to start at that keyframe, so the curve keeps to the
    // placement rule (and reads back as written) with the same values.
    void rebuild() {
        KeyFrameMap merged;
        for (const auto& entry : sourceKeyFrames())
            if (!deletions_.count(entry.time)) merged.push_back(entry);
        for (const auto& entry : edits_) MapUtil::put(merged, entry.time, entry.keyframe->clone());
        Base::cutLeadInsToTheirSegments(merged);
        this->keyframes_.swap(merged);
    }

    static bool sameKeyFrame(const KeyFrame<T>& a, const KeyFrame<T>& b) {
        return ValueTraits<T>::same(a.value(), b.value()) && a.duration() == b.duration() &&
               a.interpolaterName() == b.interpolaterName();
    }

    // After an edit of the curve: what differs from the source becomes the difference.
    void recomputeDifference() {
        const KeyFrameMap source = sourceKeyFrames();
        KeyFrameMap edits;
        std::set<RationalTime> deletions;
        for (const auto& entry : this->keyframes_) {
            const auto match = MapUtil::find(source, entry.time);
            if (match == source.end() || !sameKeyFrame(*match->keyframe, *entry.keyframe))
                edits.push_back({entry.time, entry.keyframe->clone()});
        }
        for (const auto& entry : source)
            if (MapUtil::find(this->keyframes_, entry.time) == this->keyframes_.end())
                deletions.insert(entry.time);
        edits_.swap(edits);
        deletions_.swap(deletions);
    }

    boost::shared_ptr<Parameter<T>> source_;
    KeyFrameMap edits_;
    std::set<RationalTime> deletions_;
    bool ignoreSource_ = false;
    SourceObserver sourceObserver_;
};

} // namespace VelaMediaLib

// Built once in the library for every value type.
namespace VelaMediaLib {
#define VELA_EXTERN_DIFF_PARAMETER(Type)                                                                     \
    extern template class VELAMEDIALIB_EXTERN_TEMPLATE DiffParameter<Type>;
VELA_FOR_EACH_PARAMETER_VALUE_TYPE(VELA_EXTERN_DIFF_PARAMETER)
#undef VELA_EXTERN_DIFF_PARAMETER
} // namespace VelaMediaLib
