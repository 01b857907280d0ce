#include <VelaMediaLib/document/TransitionReader.h>
#include <VelaMediaLib/document/detail/ReadSupport.h>
#include <VelaMediaLib/document/format/detail/JSONTreeAccess.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/model/media/Transition.h>
#include <VelaMediaLib/model/timeline/Track.h>

namespace VelaMediaLib {

boost::shared_ptr<Media> TransitionReader::mediaOf(const Json::Value& value, const char* key) const {
    const Json::Value* id = optionalMember(value, key);
    if (!id) return {};
    const long long named = jsonValueAsInt64(*id);
    const auto found = context().medias.find(named);
    if (found == context().medias.end()) refuseDocument("unknown media id: " + std::to_string(named));
    return found->second;
}

// A track lists the transitions at its own clips' edges (the writer names no
// clip of another track). Clips an edit pulled apart may still share one,
// and a trim may leave a clip shorter than its transition: both are states
// the model keeps, so they read back as written.
void TransitionReader::checkSides(const std::string& name, const MediaPtr& left,
                                  const MediaPtr& right) const {
    for (const MediaPtr& side : {left, right})
        if (side && (!track_ || !track_->hasMedia(side)))
            refuseDocument("transition " + name + " names a clip of another track");
}

bool TransitionReader::read(const Json::Value& value) {
    setValue(value);
    documentObject(value, "a transition object");
    const std::string name = jsonValueAsString(requiredMember(value, "name", "a transition"));
    const long long duration = jsonValueAsVelaTime(requiredMember(value, "duration", "a transition"));
    if (duration < 0)
        refuseDocument("transition " + name + ": negative duration " + std::to_string(duration));
    const MediaPtr left = mediaOf(value, "leftMedia");
    const MediaPtr right = mediaOf(value, "rightMedia");
    checkSides(name, left, right);
    transition_ = boost::shared_ptr<Transition>(new Transition(name, duration));
    if (const Json::Value* attributes = optionalMember(value, "attributes"))
        transition_->setAttributes(jsonTreeFromValue(documentObject(*attributes, "an object of attributes")));
    if (left) left->setRightTransition(transition_);
    if (right) right->setLeftTransition(transition_);
    return true;
}

} // namespace VelaMediaLib
