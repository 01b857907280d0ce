#include <VelaMediaLib/time/interpolaters/BezierInterpolater.h>

#include <VelaMediaLib/document/format/JSONValues.h>
#include <VelaMediaLib/time/interpolaters/InterpolaterFactory.h>

#include <charconv>

namespace VelaMediaLib {
namespace {

std::string pointText(const Point3d& p) {
    return formatDouble(p.x) + "," + formatDouble(p.y) + "," + formatDouble(p.z);
}

// "x,y,z" back to a point; false when the text is not three numbers.
bool parsePoint(const std::string& text, Point3d& point) {
    double values[3];
    const char* at = text.data();
    const char* end = text.data() + text.size();
    for (int i = 0; i < 3; ++i) {
        const std::from_chars_result result = std::from_chars(at, end, values[i]);
        if (result.ec != std::errc()) return false;
        at = result.ptr;
        if (i < 2 && (at == end || *at++ != ',')) return false;
    }
    if (at != end) return false;
    point = Point3d(values[0], values[1], values[2]);
    return true;
}

} // namespace

BezierInterpolater::BezierInterpolater(const Point3d& cp1, const Point3d& cp2,
                                       const std::string& temporalInterpolaterName)
    : Interpolater<Point3d>(InterpolaterNameConstants::s_bezierName), cp1_(cp1), cp2_(cp2),
      temporal_(InterpolaterFactory<double>::byName(temporalInterpolaterName)) {}

std::string BezierInterpolater::asJson() const {
    return "\"" + name() + "(" + temporalInterpolaterName() + ";" + pointText(cp1_) + ";" + pointText(cp2_) +
           ")\"";
}

bool BezierInterpolater::sameAs(const Interpolater<Point3d>& other) const {
    if (this == &other) return true;
    const BezierInterpolater* bezier = dynamic_cast<const BezierInterpolater*>(&other);
    return bezier && bezier->cp1_ == cp1_ && bezier->cp2_ == cp2_ && temporal_->sameAs(*bezier->temporal_);
}

Point3d BezierInterpolater::pointAt(const Point3d& a, const Point3d& b, double s) const {
    const double r = 1.0 - s;
    const double wa = r * r * r, w1 = 3.0 * s * r * r, w2 = 3.0 * s * s * r, wb = s * s * s;
    return Point3d(wa * a.x + w1 * cp1_.x + w2 * cp2_.x + wb * b.x,
                   wa * a.y + w1 * cp1_.y + w2 * cp2_.y + wb * b.y,
                   wa * a.z + w1 * cp1_.z + w2 * cp2_.z + wb * b.z);
}

Point3d BezierInterpolater::doInterpolate(const Point3d& a, const Point3d& b, const RationalTime& t0,
                                          const RationalTime& t1, double t) const {
    const double start = t0.asDouble(), end = t1.asDouble();
    const double u = end == start ? 1.0 : (t - start) / (end - start);
    return pointAt(a, b, ease(u));
}

boost::shared_ptr<BezierInterpolater> BezierInterpolater::fromName(const std::string& name) {
    const std::string prefix = std::string(InterpolaterNameConstants::s_bezierName) + "(";
    if (name.compare(0, prefix.size(), prefix) != 0 || name.back() != ')') return {};
    const std::string body = name.substr(prefix.size(), name.size() - prefix.size() - 1);
    const size_t first = body.find(';'), second = body.find(';', first + 1);
    if (first == std::string::npos || second == std::string::npos) return {};
    Point3d cp1, cp2;
    if (!parsePoint(body.substr(first + 1, second - first - 1), cp1) ||
        !parsePoint(body.substr(second + 1), cp2))
        return {};
    return boost::shared_ptr<BezierInterpolater>(new BezierInterpolater(cp1, cp2, body.substr(0, first)));
}

} // namespace VelaMediaLib
