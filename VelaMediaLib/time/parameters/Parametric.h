#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/XMLIdentified.h>
#include <VelaMediaLib/time/sync/LazyCreation.h>
#include <VelaMediaLib/time/sync/ProjectToken.h>
#include <VelaMediaLib/time/parameters/Parameter.h>
#include <VelaMediaLib/time/rational/TimeScalable.h>

#include <vector>

namespace VelaMediaLib {

class XMLOptions;

/// An object with named, keyframed parameters. A kind declares its parameters
/// and their defaults; each is made when first asked for, so objects pay only
/// for the parameters in use, and queries that find a parameter not yet made
/// answer its default. Parameter times are this object's parametric time,
/// one tick per unit.
///
/// Making a parameter on first use is invisible to readers: it happens under
/// the read lock (the new parameter holds the default they would have
/// answered) and never asks for the write lock, so a reader's snapshot stays
/// one.
class VELAMEDIALIB_API Parametric : public virtual XMLIdentified,
                                    public virtual TimeScalable,
                                    public virtual ProjectToken {
public:
    explicit Parametric(const boost::weak_ptr<const ThreadSafe>& token) { recordProjectToken(token); }

    /// The parameter of the name, made with its default if need be; null for
    /// a name the object does not have. Takes only the read lock.
    boost::shared_ptr<ParameterInterface> parameter(const std::string& name) const;
    template <typename T>
    boost::shared_ptr<Parameter<T>> typedParameter(const std::string& name) const {
        return boost::dynamic_pointer_cast<Parameter<T>>(parameter(name));
    }
    /// The declared parameters and any added ones, in name order.
    std::vector<std::string> parameterNames() const;
    /// Adds or replaces a parameter of the name.
    void addParameter(const std::string& name, const boost::shared_ptr<ParameterInterface>& parameter);
    /// Forgets a made parameter, so that the object answers its default again
    /// and writes it no more (an undo of the edit that made it); returns it,
    /// or null when it was not made. Tells nobody, as making it does not.
    boost::shared_ptr<ParameterInterface> removeParameter(const std::string& name);
    bool hasMadeParameter(const std::string& name) const;
    /// Whether any parameter has been made (one not made holds its default).
    bool hasMadeParameters() const;

    /// The value at the parametric time without making the parameter.
    template <typename T>
    T parameterValueAtTime(const std::string& name, const RationalTime& time, const T& fallback) const {
        const auto typed = boost::dynamic_pointer_cast<Parameter<T>>(madeParameter(name));
        return typed ? typed->valueAtTime(time) : fallback;
    }

    /// Writes the "parameters" member of the object being written (whose
    /// members stand at indent): every parameter made (those not made hold
    /// their defaults, which reading gives back).
    void toJSONParameterList(XMLOptions& options, int indent) const;
    /// Reads a document's "parameters" object: each member becomes the value
    /// of the parameter of its name, built from no keyframes (so what was
    /// written reads back equal). A parameter already made takes the value
    /// read and stays the same object; it and the object (when observable)
    /// notify. All or nothing: a member that fails to read leaves every
    /// parameter as it was.
    void readParameterList(const Json::Value& parameters);

    SafeRational timeScale() const override { return SafeRational(1); }
    /// The time scale this object's parameters hold: a shared object of its
    /// own, never the owner itself, so a parameter kept past its owner still
    /// answers. One tick per unit unless a kind says otherwise.
    virtual boost::shared_ptr<const TimeScalable> sharedTimeScale() const;

protected:
    /// A new parameter of the name with its default, or null for unknown names.
    /// It may be made under a reader's lock: it must take no write lock.
    virtual boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const;
    virtual std::vector<std::string> defaultParameterNames() const { return {}; }
    /// Clones of the parameters made so far, for a cloned object.
    void cloneParametersInto(Parametric& other) const;

private:
    boost::shared_ptr<ParameterInterface> madeParameter(const std::string& name) const;

    mutable NamedEntries<ParameterInterface> parameters_;
};

} // namespace VelaMediaLib
