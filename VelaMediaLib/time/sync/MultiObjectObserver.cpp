#include <VelaMediaLib/time/sync/MultiObjectObserver.h>

#include <algorithm>

namespace VelaMediaLib {

MultiObjectObserver::MultiObjectObserver(Function function) : function_(std::move(function)) {}

MultiObjectObserver::~MultiObjectObserver() { stopObservingAll(); }

void MultiObjectObserver::observe(const boost::shared_ptr<Observable>& subject) {
    subject->attach(this);
    subjects_.push_back(subject);
}

void MultiObjectObserver::stopObserving(const boost::shared_ptr<Observable>& subject) {
    subject->detach(this);
    subjects_.erase(std::remove_if(subjects_.begin(), subjects_.end(),
                                   [&](const boost::weak_ptr<Observable>& held) {
                                       return held.expired() || held.lock() == subject;
                                   }),
                    subjects_.end());
}

void MultiObjectObserver::stopObservingAll() {
    for (const boost::weak_ptr<Observable>& held : subjects_)
        if (const boost::shared_ptr<Observable> subject = held.lock()) subject->detach(this);
    subjects_.clear();
}

void MultiObjectObserver::update(Observable* subject) {
    if (function_) function_(subject);
}

} // namespace VelaMediaLib
