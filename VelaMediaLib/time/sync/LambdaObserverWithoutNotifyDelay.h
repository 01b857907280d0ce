#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/Observable.h>

#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

/// An observer that calls a stored function and is never held back by a
/// notify delay.
class VELAMEDIALIB_API LambdaObserverWithoutNotifyDelay : public Observer {
public:
    typedef boost::function<void(Observable*)> Function;

    explicit LambdaObserverWithoutNotifyDelay(Function function);
    ~LambdaObserverWithoutNotifyDelay() override;

    /// Attached to the subject for as long as the returned observer lives.
    static boost::shared_ptr<LambdaObserverWithoutNotifyDelay>
    createWithScopedAttachDetach(const boost::shared_ptr<Observable>& subject, Function function);

    void update(Observable* subject) override;

private:
    Function function_;
    boost::weak_ptr<Observable> attachedTo_;
};

} // namespace VelaMediaLib
