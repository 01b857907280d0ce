#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/RationalTime.h>

#include <boost/shared_ptr.hpp>
#include <string>
#include <typeinfo>

namespace VelaMediaLib {

/// How a value moves between two keyframes. One shared, immutable instance
/// exists per kind and value type.
///
/// The lead-in of the keyframe that ends a segment enters every kind the same
/// way: with no lead-in the transition spans the whole segment, from the
/// earlier keyframe's time; with a lead-in it starts that long before the
/// later keyframe (never before the earlier one) and the value holds at the
/// earlier keyframe's value until then.
template <typename T>
class VELAMEDIALIB_TEMPLATE_API Interpolater {
public:
    virtual ~Interpolater() = default;

    /// The value between a (reached at t0) and b (reached at t1) at time t.
    virtual T interpolate(const T& a, const T& b, const RationalTime& t0, const RationalTime& t1, double t,
                          const RationalTime& leadIn = RationalTime()) const {
        RationalTime start = t0;
        if (leadIn.asRational().numerator() > 0) { // denominators are positive
            const RationalTime leadStart(t1.asRational() - leadIn.asRational());
            if (leadStart > t0) start = leadStart;
        }
        if (t <= start.asDouble()) return a;
        return doInterpolate(a, b, start, t1, t);
    }
    /// The name as a JSON string value.
    virtual std::string asJson() const { return "\"" + name_ + "\""; }
    virtual T doInterpolate(const T& a, const T& b, const RationalTime& t0, const RationalTime& t1,
                            double t) const = 0;
    virtual double ease(double u) const = 0;
    /// Whether the other moves values exactly as this one does: the same kind
    /// and name, and whatever shapes a kind's curve (control points, exponents).
    virtual bool sameAs(const Interpolater& other) const {
        return this == &other || (typeid(*this) == typeid(other) && name_ == other.name_);
    }

    const std::string& name() const { return name_; }

protected:
    explicit Interpolater(std::string name) : name_(std::move(name)) {}

private:
    const std::string name_;
};

/// The one shared instance of an interpolater kind.
template <typename Kind>
class VELAMEDIALIB_TEMPLATE_API SharedInterpolaterInstance {
public:
    static boost::shared_ptr<Kind> getInstance() {
        static const boost::shared_ptr<Kind> instance(new Kind());
        return instance;
    }
};

} // namespace VelaMediaLib
