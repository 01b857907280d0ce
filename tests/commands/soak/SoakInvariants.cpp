// What every track and clip of the soak's project must hold after each step.
#include "SoakDriver.h"

#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/media/StitchedMedia.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <sstream>
#include <unordered_map>

namespace VelaMediaLib {
namespace soak {

namespace {

class Checker {
public:
    Checker(const SoakState& state, bool packed) : state_(state), packed_(packed) {
        for (size_t c = 0; c < state.clips.size(); ++c) names_[state.clips[c].get()] = c;
    }

    std::string run() {
        const std::vector<TrackPtr> tracks = state_.tracks();
        for (size_t t = 0; t < tracks.size(); ++t)
            checkTrack(*tracks[t], "track " + std::to_string(t), packed_);
        const std::vector<TrackPtr> inner = state_.groupTracks();
        for (size_t t = 0; t < inner.size(); ++t)
            checkTrack(*inner[t], "group track " + std::to_string(t), false);
        for (size_t c = 0; c < state_.clips.size(); ++c) checkClip(*state_.clips[c], c);
        return out_.str();
    }

private:
    std::string name(const Media* media) const {
        const auto found = names_.find(media);
        if (found != names_.end()) return "clip " + std::to_string(found->second);
        return media ? "an unknown clip" : "no clip";
    }

    // Only the timeline's tracks have a magnetizer: a group's track keeps the
    // flag of the track it was made from, but nothing closes its gaps.
    void checkTrack(const Track& track, const std::string& where, bool packed) {
        const std::vector<MediaPtr> clips = track.medias();
        const bool magnetic = packed && track.magneticAttribute()->value();
        VelaTime end = 0;
        for (size_t i = 0; i < clips.size(); ++i) {
            const MediaPtr& clip = clips[i];
            const Range<VelaTime> range = clip->trackRange();
            const std::string what = where + " " + name(clip.get()) + " [" + std::to_string(range.start()) +
                                     ", " + std::to_string(range.end()) + ")";
            if (range.duration() < 1) out_ << what << ": no tick; ";
            if (i > 0 && range.start() < end)
                out_ << what << ": overlaps the clip before, ending " << end << "; ";
            if (magnetic && range.start() != end) out_ << what << ": a gap on a magnetic track; ";
            if (clip->parent().get() != static_cast<const SubTimeline*>(&track))
                out_ << what << ": its parent is not the track; ";
            checkQueries(track, clips, i, what);
            checkTransitions(*clip, what);
            end = range.end();
        }
    }

    // The time queries answer from the track's index: they must agree with the clips.
    void checkQueries(const Track& track, const std::vector<MediaPtr>& clips, size_t i,
                      const std::string& what) {
        const Range<VelaTime> range = clips[i]->trackRange();
        const bool touchesBefore = i > 0 && clips[i - 1]->trackRange().end() == range.start();
        const Track::Pair atStart = track.mediaAtTime(range.start());
        const Track::Pair expected =
            touchesBefore ? Track::Pair(clips[i - 1], clips[i]) : Track::Pair(clips[i], {});
        if (atStart != expected)
            out_ << what << ": the index answers " << name(atStart.first.get()) << " at its start; ";
        if (track.mediaAtTime(range.end() - 1) != Track::Pair(clips[i], {}) && range.duration() > 1)
            out_ << what << ": the index does not find it at its last tick; ";
        const bool touchesAfter = i + 1 < clips.size() && clips[i + 1]->trackRange().start() == range.end();
        if (!touchesAfter && track.mediaAtTime(range.end()) != Track::Pair())
            out_ << what << ": the index finds a clip in the gap after it; ";
    }

    void checkTransitions(const Media& clip, const std::string& what) {
        const TransitionPtr left = clip.leftTransition(), right = clip.rightTransition();
        if (left && left->rightMedia().get() != &clip)
            out_ << what << ": its left transition names another clip; ";
        if (right && right->leftMedia().get() != &clip)
            out_ << what << ": its right transition names another clip; ";
        // A trim may leave a clip one tick shorter than its transitions together.
        const VelaTime together = (left ? left->duration() : 0) + (right ? right->duration() : 0);
        if (together - 1 > clip.duration())
            out_ << what << ": shorter (" << clip.duration() << ") than its transitions (" << together
                 << "); ";
        if ((left && left->duration() < 0) || (right && right->duration() < 0))
            out_ << what << ": a transition of negative length; ";
    }

    void checkClip(const Media& clip, size_t c) {
        const MediaState s = clip.state();
        // As the clip's own restore check measures it: no start before the
        // media's, and an end past it by no more than 0.001 (after many
        // edit-rate changes denominators outgrow exact arithmetic and a value
        // is rounded, so the end may pass by a hair the model accepts).
        const double kAcceptedPastEnd = 0.001;
        if (s.mediaStart < s.minMediaStart ||
            (!s.maxUnbounded() && (s.mediaEnd() - s.maxMediaEnd).asDouble() > kAcceptedPastEnd))
            out_ << "clip " << c << ": media outside its limits; ";
        if (!Group::asGroup(&clip) && !dynamic_cast<const StitchedMedia*>(&clip) &&
            s.duration != RationalUtil::toVelaTime(RationalUtil::Round(s.mediaDuration * s.scalar)))
            out_ << "clip " << c << ": duration " << s.duration << " breaks the duration rule; ";
    }

    const SoakState& state_;
    bool packed_;
    std::unordered_map<const Media*, size_t> names_;
    std::ostringstream out_;
};

} // namespace

std::string invariantViolations(const SoakState& state, bool packed) { return Checker(state, packed).run(); }

} // namespace soak
} // namespace VelaMediaLib
