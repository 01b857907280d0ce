#pragma once
// Helpers for the time and document tests: a small parametric kind, an edit-rate observer, and the deadline
// for tests that run threads.

#include "../ThreadTestSupport.h"

#include <VelaMediaLib/time/parameters/Attributable.h>
#include <VelaMediaLib/time/parameters/Parametric.h>
#include <VelaMediaLib/time/parameters/InterpolatingParam.h>
#include <VelaMediaLib/time/rational/ProjectEditRate.h>
#include <VelaMediaLib/time/sync/Observer.h>

#include <vector>

namespace VelaMediaLib {
namespace testing {

/// A kind with two declared parameters ("level" 1.0 and "pan" 0.0), made on first use, and attributes.
class Knob : public Parametric, public Attributable {
public:
    explicit Knob(const boost::weak_ptr<const ThreadSafe>& token) : Parametric(token), Attributable(token) {}

protected:
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override {
        if (name == "level") return InterpolatingParam<double>::create(projectMutex(), name, 1.0);
        if (name == "pan") return InterpolatingParam<double>::create(projectMutex(), name, 0.0);
        return Parametric::createDefaultParameter(name);
    }
    std::vector<std::string> defaultParameterNames() const override { return {"level", "pan"}; }
};

typedef boost::rational<unsigned long> Rate;

/// Records the rate it reads each time the edit rate tells it of a change.
struct RateReader : Observer {
    const ProjectEditRate* rate = nullptr;
    std::vector<Rate> seen;
    void update(Observable*) override { seen.push_back(rate->editRate()); }
};

} // namespace testing
} // namespace VelaMediaLib
