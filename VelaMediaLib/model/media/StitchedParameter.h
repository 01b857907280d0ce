#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/time/parameters/ParameterImpl.h>

namespace VelaMediaLib {

/// A parameter of a stitched media's parts seen as one, in the stitched
/// media's parameter time (its internal track's time): the value at a time
/// is what the part playing it answers at its own time (the first part before
/// the parts, the last after them), so each stitch is an exact step.
///
/// It is a view, not a curve of its own: its keyframes list the parts'
/// keyframes that lie within each part (from its start, up to but not at its
/// end), moved by the part's start, plus one at each part's start holding
/// the value there; interpolaters are the parameter's own. They are read
/// when it is made and again by refresh; edit the parts' parameters, not
/// these keyframes. Once the stitched media has gone it answers from the
/// keyframes it last read.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API StitchedParameter : public ParameterImpl<T> {
public:
    typedef typename ParameterImpl<T>::KeyFrameMap KeyFrameMap;

    /// The parameter of the name across the stitched media's parts. Throws
    /// VelaMediaLibException "no stitched media" for none.
    static boost::shared_ptr<StitchedParameter> create(const boost::shared_ptr<const StitchedMedia>& stitched,
                                                       const std::string& name) {
        if (!stitched) throw VelaMediaLibException("no stitched media");
        const boost::shared_ptr<StitchedParameter> made(new StitchedParameter(stitched, name));
        made->refresh();
        return made;
    }

    /// Reads the parts' keyframes again (they may have been edited since).
    /// With no part left to read, the curve the parts no longer give goes:
    /// one keyframe keeps the value it held at the start.
    void refresh() {
        KeyFrameMap curve = readParts();
        this->edit([&] {
            if (curve.empty() && !this->keyframes_.empty())
                curve.push_back(
                    {RationalTime(0),
                     this->newKeyFrame(RationalTime(0), this->keyframes_.front().keyframe->value(), 0)});
            if (!curve.empty()) this->keyframes_.swap(curve);
        });
    }

    T valueAtTime(const RationalTime& time) const override {
        const boost::shared_ptr<const StitchedMedia> stitched = stitched_.lock();
        if (stitched) {
            const StitchedMedia::MediaAndSubTime found =
                stitched->mediaAndSubTimeForParameterTime(time.asRational());
            if (const auto part = partParameter(found.first)) return part->valueAtTime(found.second);
        }
        return ParameterImpl<T>::valueAtTime(time);
    }

    /// A portion of a view over parts is no parameter of its own: throws
    /// VelaMediaLibException "StitchedParameter<T>::copyPortion not implemented".
    boost::shared_ptr<Parameter<T>> copyPortion(const Range<RationalTime>&) const override {
        throw VelaMediaLibException("StitchedParameter<T>::copyPortion not implemented");
    }

protected:
    boost::shared_ptr<ParameterImpl<T>> cloneImpl() const override {
        return boost::shared_ptr<ParameterImpl<T>>(new StitchedParameter(*this));
    }

private:
    StitchedParameter(const boost::shared_ptr<const StitchedMedia>& stitched, const std::string& name)
        : ParameterImpl<T>(stitched->projectMutex(), name), stitched_(stitched) {}

    boost::shared_ptr<Parameter<T>> partParameter(const MediaPtr& part) const {
        return part ? part->template typedParameter<T>(this->identifier())
                    : boost::shared_ptr<Parameter<T>>();
    }

    KeyFrameMap readParts() const {
        KeyFrameMap curve;
        const boost::shared_ptr<const StitchedMedia> stitched = stitched_.lock();
        if (!stitched) return curve;
        for (const MediaPtr& part : stitched->medias()) {
            const auto parameter = partParameter(part);
            if (!parameter) continue;
            const Range<VelaTime> range = part->trackRange();
            const RationalTime start(range.start()), length(range.duration());
            curve.push_back({start, this->newKeyFrame(start, parameter->valueAtTime(RationalTime(0)), 0)});
            const auto times = parameter->keyframeTimes();
            for (const RationalTime& time : *times) {
                if (time <= RationalTime(0) || time >= length) continue;
                const auto keyframe = parameter->keyframeAtTime(time);
                curve.push_back(
                    {start + time, this->newKeyFrame(start + time, keyframe->value(), keyframe->duration())});
            }
        }
        ParameterImpl<T>::cutLeadInsToTheirSegments(curve);
        return curve;
    }

    boost::weak_ptr<const StitchedMedia> stitched_;
};

} // namespace VelaMediaLib
