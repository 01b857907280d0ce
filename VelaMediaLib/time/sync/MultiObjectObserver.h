#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/Observable.h>

#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>
#include <vector>

namespace VelaMediaLib {

/// Observes several subjects of one project with one function, and detaches
/// from those still alive when it goes. Its notifications follow the
/// project's notify delays like any ordinary observer's.
class VELAMEDIALIB_API MultiObjectObserver : public Observer {
public:
    typedef boost::function<void(Observable*)> Function;

    explicit MultiObjectObserver(Function function);
    ~MultiObjectObserver() override;
    MultiObjectObserver(const MultiObjectObserver&) = delete;
    MultiObjectObserver& operator=(const MultiObjectObserver&) = delete;

    void observe(const boost::shared_ptr<Observable>& subject);
    void stopObserving(const boost::shared_ptr<Observable>& subject);
    void stopObservingAll();

    void update(Observable* subject) override;

private:
    Function function_;
    std::vector<boost::weak_ptr<Observable>> subjects_;
};

} // namespace VelaMediaLib
