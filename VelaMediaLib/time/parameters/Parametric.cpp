#include <VelaMediaLib/time/parameters/Parametric.h>

#include <VelaMediaLib/document/format/JSONWriter.h>
#include <VelaMediaLib/document/format/XMLOptions.h>
#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <json/value.h>
#include <algorithm>
#include <utility>

namespace VelaMediaLib {

namespace {

class UnitTimeScale : public TimeScalable {
public:
    SafeRational timeScale() const override { return SafeRational(1); }
};

typedef std::vector<std::pair<std::string, boost::shared_ptr<ParameterInterface>>> NamedParameters;

} // namespace

boost::shared_ptr<const TimeScalable> Parametric::sharedTimeScale() const {
    static const boost::shared_ptr<const TimeScalable> unit(new UnitTimeScale);
    return unit;
}

boost::shared_ptr<ParameterInterface> Parametric::createDefaultParameter(const std::string&) const {
    return boost::shared_ptr<ParameterInterface>();
}

boost::shared_ptr<ParameterInterface> Parametric::madeParameter(const std::string& name) const {
    ScopedReadLock lock(projectLock());
    return parameters_.find(name);
}

// Made outside any lock and linked in under the read lock; a thread that
// made the same parameter at the same moment gets the one linked in first.
boost::shared_ptr<ParameterInterface> Parametric::parameter(const std::string& name) const {
    if (const auto made = madeParameter(name)) return made;
    const boost::shared_ptr<ParameterInterface> created = createDefaultParameter(name);
    if (!created) return created;
    ScopedReadLock lock(projectLock());
    return parameters_.insertIfAbsent(name, created);
}

std::vector<std::string> Parametric::parameterNames() const {
    std::vector<std::string> names = defaultParameterNames();
    {
        ScopedReadLock lock(projectLock());
        parameters_.forEach([&](const std::string& name, const boost::shared_ptr<ParameterInterface>&) {
            names.push_back(name);
        });
    }
    std::sort(names.begin(), names.end());
    names.erase(std::unique(names.begin(), names.end()), names.end());
    return names;
}

void Parametric::addParameter(const std::string& name,
                              const boost::shared_ptr<ParameterInterface>& parameter) {
    if (!parameter) throw AddRemoveException("no parameter to add as " + name);
    ScopedWriteLock lock(projectMutex());
    parameters_.set(name, parameter);
}

boost::shared_ptr<ParameterInterface> Parametric::removeParameter(const std::string& name) {
    ScopedWriteLock lock(projectMutex());
    return parameters_.erase(name);
}

bool Parametric::hasMadeParameter(const std::string& name) const { return bool(madeParameter(name)); }

bool Parametric::hasMadeParameters() const {
    ScopedReadLock lock(projectLock());
    bool any = false;
    parameters_.forEach(
        [&](const std::string&, const boost::shared_ptr<ParameterInterface>&) { any = true; });
    return any;
}

void Parametric::toJSONParameterList(XMLOptions& options, int indent) const {
    NamedParameters made;
    {
        ScopedReadLock lock(projectLock());
        parameters_.forEach([&](const std::string& name, const boost::shared_ptr<ParameterInterface>& p) {
            made.emplace_back(name, p);
        });
    }
    options.key("parameters");
    JSONWriter members(options, indent);
    for (const auto& entry : made)
        if (entry.second->shouldSerialize())
            entry.second->toJSON(options, members.memberLevel(), entry.first);
}

// Every member is read into a copy first (of the kind of the parameter made,
// or of the declared default), so a failure leaves the object as it was. Under
// one write lock each parameter made by then takes its copy's state, staying
// the same object for whoever holds or observes it; the copies of parameters
// not yet made go in themselves. Observers hear after the lock.
void Parametric::readParameterList(const Json::Value& parameters) {
    if (!parameters.isObject()) return;
    NamedParameters read;
    for (const std::string& name : parameters.getMemberNames()) {
        const boost::shared_ptr<ParameterInterface> made = madeParameter(name);
        const boost::shared_ptr<ParameterInterface> kind = made ? made : createDefaultParameter(name);
        if (!kind) continue; // a name this object does not have
        read.emplace_back(name, kind->readCopyFromJSON(parameters[name]));
    }
    if (read.empty()) return;
    std::vector<boost::shared_ptr<ParameterInterface>> changed;
    {
        ScopedWriteLock lock(projectMutex());
        for (const auto& entry : read) {
            const boost::shared_ptr<ParameterInterface> existing = parameters_.find(entry.first);
            if (existing && existing->takeStateOf(*entry.second))
                changed.push_back(existing);
            else
                parameters_.set(entry.first, entry.second); // not made, or replaced by another kind meanwhile
        }
    }
    for (const auto& parameter : changed) parameter->notify();
    if (Observable* owner = dynamic_cast<Observable*>(this)) owner->notify();
}

void Parametric::cloneParametersInto(Parametric& other) const {
    ScopedReadLock lock(projectLock());
    parameters_.forEach([&](const std::string& name, const boost::shared_ptr<ParameterInterface>& p) {
        const boost::shared_ptr<ParameterInterface> copy = p->cloneParameter();
        copy->setTimeScalable(other.sharedTimeScale());
        other.parameters_.set(name, copy);
    });
}

} // namespace VelaMediaLib
