#include <VelaMediaLib/model/media/Transition.h>

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

} // namespace VelaMediaLib
