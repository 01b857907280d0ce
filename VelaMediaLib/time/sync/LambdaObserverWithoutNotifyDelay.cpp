#include <VelaMediaLib/time/sync/LambdaObserverWithoutNotifyDelay.h>

namespace VelaMediaLib {

LambdaObserverWithoutNotifyDelay::LambdaObserverWithoutNotifyDelay(Function function)
    : function_(std::move(function)) {}

LambdaObserverWithoutNotifyDelay::~LambdaObserverWithoutNotifyDelay() {
    if (const boost::shared_ptr<Observable> subject = attachedTo_.lock()) subject->detach(this);
}

boost::shared_ptr<LambdaObserverWithoutNotifyDelay>
LambdaObserverWithoutNotifyDelay::createWithScopedAttachDetach(const boost::shared_ptr<Observable>& subject,
                                                               Function function) {
    boost::shared_ptr<LambdaObserverWithoutNotifyDelay> observer(
        new LambdaObserverWithoutNotifyDelay(std::move(function)));
    subject->attachWithoutNotifyDelay(observer.get());
    observer->attachedTo_ = subject;
    return observer;
}

void LambdaObserverWithoutNotifyDelay::update(Observable* subject) {
    if (function_) function_(subject);
}

} // namespace VelaMediaLib
