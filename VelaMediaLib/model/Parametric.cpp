#include <VelaMediaLib/model/Parametric.h>

#include <VelaMediaLib/document/JSONWriter.h>
#include <VelaMediaLib/document/XMLOptions.h>
#include <VelaMediaLib/time/VelaMediaLibException.h>

#include <algorithm>

namespace VelaMediaLib {

namespace {

class UnitTimeScale : public TimeScalable {
public:
    SafeRational timeScale() const override { return SafeRational(1); }
};

} // namespace

boost::shared_ptr<const TimeScalable> Parametric::sharedTimeScale() const {
    static const boost::shared_ptr<const TimeScalable> unit(new UnitTimeScale);
    return unit;
}

boost::shared_ptr<ParameterInterface> Parametric::createDefaultParameter(const std::string&) const {
    return boost::shared_ptr<ParameterInterface>();
}

boost::shared_ptr<ParameterInterface> Parametric::madeParameter(const std::string& name) const {
    ScopedReadLock lock(parametersToken_);
    if (!parameters_) return boost::shared_ptr<ParameterInterface>();
    const auto found = parameters_->find(name);
    return found == parameters_->end() ? boost::shared_ptr<ParameterInterface>() : found->second;
}

boost::shared_ptr<ParameterInterface> Parametric::parameter(const std::string& name) const {
    if (const auto made = madeParameter(name)) return made;
    const boost::shared_ptr<ParameterInterface> created = createDefaultParameter(name);
    if (!created) return created;
    ScopedWriteLock lock(parametersToken_);
    if (!parameters_) parameters_.reset(new Map);
    const auto inserted = parameters_->insert(Map::value_type(name, created));
    return inserted.first->second; // another thread may have made it first
}

std::vector<std::string> Parametric::parameterNames() const {
    std::vector<std::string> names = defaultParameterNames();
    {
        ScopedReadLock lock(parametersToken_);
        if (parameters_)
            for (const auto& entry : *parameters_) names.push_back(entry.first);
    }
    std::sort(names.begin(), names.end());
    names.erase(std::unique(names.begin(), names.end()), names.end());
    return names;
}

void Parametric::addParameter(const std::string& name,
                              const boost::shared_ptr<ParameterInterface>& parameter) {
    if (!parameter) throw AddRemoveException("no parameter to add as " + name);
    ScopedWriteLock lock(parametersToken_);
    if (!parameters_) parameters_.reset(new Map);
    (*parameters_)[name] = parameter;
}

bool Parametric::hasMadeParameter(const std::string& name) const { return bool(madeParameter(name)); }

void Parametric::toJSONParameterList(JSONWriter& writer) const {
    Map made;
    {
        ScopedReadLock lock(parametersToken_);
        if (parameters_) made = *parameters_;
    }
    writer.key("parameters");
    JSONWriter members(writer.options(), writer.memberLevel());
    for (const auto& entry : made) {
        if (!entry.second->shouldSerialize()) continue;
        members.element();
        entry.second->toJSON(writer.options(), members.memberLevel(), entry.first);
    }
}

void Parametric::readParameterList(const Json::Value& parameters) {
    if (!parameters.isObject()) return;
    for (const std::string& name : parameters.getMemberNames())
        if (const auto target = parameter(name)) target->readFromJSON(parameters[name]);
}

void Parametric::cloneParametersInto(Parametric& other) const {
    ScopedReadLock lock(parametersToken_);
    if (!parameters_) return;
    other.parameters_.reset(new Map);
    for (const auto& entry : *parameters_) {
        const boost::shared_ptr<ParameterInterface> copy = entry.second->cloneParameter();
        copy->setTimeScalable(other.sharedTimeScale());
        (*other.parameters_)[entry.first] = copy;
    }
}

} // namespace VelaMediaLib
