#include <VelaMediaLib/model/media/Transition.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/model/timeline/SubTimeline.h>

namespace VelaMediaLib {

void Transition::mergeMediaPairTransitions(
    const std::pair<boost::shared_ptr<Media>, boost::shared_ptr<Media>>& pair) {
    const boost::shared_ptr<Media>& earlier = pair.first;
    const boost::shared_ptr<Media>& later = pair.second;
    if (!earlier || !later || earlier->endTime() != later->startTime()) return;
    const TransitionPtr shared =
        earlier->rightTransition() ? earlier->rightTransition() : later->leftTransition();
    if (!shared || !roomFor(*earlier, shared, earlier->rightTransition()) ||
        !roomFor(*later, shared, later->leftTransition()))
        return;
    earlier->setRightTransition(shared);
    later->setLeftTransition(shared);
}

bool Transition::roomFor(const Media& clip, const TransitionPtr& in, const TransitionPtr& out) {
    if (in && in->duration() < 0) return false;
    VelaTime used = in ? in->duration() : 0;
    for (const TransitionPtr& held : {clip.leftTransition(), clip.rightTransition()})
        if (held && held != out && held != in) used += held->duration();
    return used <= clip.duration();
}

VelaTime Transition::minimumTrackDuration(const Media& clip) {
    return minimumTrackDuration(lengthOf(clip.leftTransition()), lengthOf(clip.rightTransition()));
}

namespace {

// The side's clip by its id in this write; a side without a clip, whose
// clip this write has not named, or that lies off the owner, is left out.
void writeSide(XMLOptions& options, const char* key, const boost::shared_ptr<Media>& media,
               const SubTimeline* owner) {
    if (!media || (owner && media->parent().get() != owner)) return;
    const unsigned ident = options.findIdent(media.get());
    if (ident) options.key(key) << ident;
}

} // namespace

void Transition::toJSON(XMLOptions& options, int indent, const SubTimeline* owner) const {
    JSONWriter object(options, indent);
    writeJSONMember(options, object.memberLevel(), "name", name_);
    writeJSONMember(options, object.memberLevel(), "duration", (long long)duration_);
    writeSide(options, "leftMedia", leftMedia(), owner);
    writeSide(options, "rightMedia", rightMedia(), owner);
    if (attributes_.isEmpty()) return;
    options.key("attributes");
    attributes_.write(options, object.memberLevel());
}

} // namespace VelaMediaLib
