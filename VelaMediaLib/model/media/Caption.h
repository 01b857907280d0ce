#pragma once

#include <VelaMediaLib/base/CaptionData.h>
#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/VisualMediaImpl.h>

#include <limits>

namespace VelaMediaLib {

/// A clip that shows captions over the picture. It is visual (it stands on
/// the canvas and carries the visual parameters) and generated: it has no
/// media extent, so its static editor changes only the track range and it
/// can be extended without limit.
///
/// Its captions are the keyframed parameter "caption": each keyframe is the
/// caption shown from its time on (it only steps), so one clip carries a run
/// of captions keyed by time. Two settings belong to the clip itself and are
/// written as members of its document object, not as attributes:
/// "maxMediaDuration", the longest it may be in ticks, and "allowTrimOut".
class VELAMEDIALIB_API Caption : public VisualMediaImpl {
public:
    /// The longest a caption may be when nothing limits it.
    static constexpr long long kNoMaxMediaDuration = std::numeric_limits<long long>::max();

    static boost::shared_ptr<Caption> create(const boost::weak_ptr<const ThreadSafe>& token,
                                             const boost::weak_ptr<ProjectEditRate>& rate, VelaTime start,
                                             VelaTime duration, const CaptionData& caption = CaptionData());

    boost::shared_ptr<Parameter<CaptionData>> captionParam() const {
        return typedParameter<CaptionData>("caption");
    }
    /// The caption shown at the clip's parametric time.
    CaptionData captionAtTime(const RationalTime& time) const;
    /// Makes the caption constant: every caption keyframe gives way to this one.
    void setCaption(const CaptionData& caption);

    long long maxMediaDuration() const;
    /// Throws ValueException<long long> for a length not greater than 0.
    void setMaxMediaDuration(long long ticks);
    bool allowTrimOut() const;
    void setAllowTrimOut(bool allow);

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;
    void toJSONSpecificProperties(XMLOptions& options, int indent) const override;

protected:
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override;
    std::vector<std::string> defaultParameterNames() const override;

private:
    Caption(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate,
            const MediaState& initial)
        : Media(token), VisualMedia(token), VisualMediaImpl(token, rate, initial, Static) {}

    long long maxMediaDuration_ = kNoMaxMediaDuration;
    bool allowTrimOut_ = true;
};

} // namespace VelaMediaLib
