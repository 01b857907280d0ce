#include <VelaMediaLib/model/media/Transition.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/model/media/Media.h>

namespace VelaMediaLib {

void Transition::mergeMediaPairTransitions(
    const std::pair<boost::shared_ptr<Media>, boost::shared_ptr<Media>>& pair) {
    const boost::shared_ptr<Media>& earlier = pair.first;
    const boost::shared_ptr<Media>& later = pair.second;
    if (!earlier || !later || earlier->endTime() != later->startTime()) return;
    const TransitionPtr shared =
        earlier->rightTransition() ? earlier->rightTransition() : later->leftTransition();
    if (!shared) return;
    earlier->setRightTransition(shared);
    later->setLeftTransition(shared);
}

namespace {

// The side's clip by its id in this write; a side without a clip, or whose
// clip this write has not named, is left out.
void writeSide(XMLOptions& options, const char* key, const boost::shared_ptr<Media>& media) {
    const unsigned ident = media ? options.findIdent(media.get()) : 0;
    if (ident) options.key(key) << ident;
}

} // namespace

void Transition::toJSON(XMLOptions& options, int indent) const {
    JSONWriter object(options, indent);
    writeJSONMember(options, object.memberLevel(), "name", name_);
    writeJSONMember(options, object.memberLevel(), "duration", (long long)duration_);
    writeSide(options, "leftMedia", leftMedia());
    writeSide(options, "rightMedia", rightMedia());
    if (attributes_.isEmpty()) return;
    options.key("attributes");
    attributes_.write(options, object.memberLevel());
}

} // namespace VelaMediaLib
