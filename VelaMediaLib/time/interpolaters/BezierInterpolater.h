#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/Point3d.h>
#include <VelaMediaLib/time/interpolaters/Interpolater.h>

namespace VelaMediaLib {

/// A position moving along a cubic Bézier curve from the earlier keyframe's
/// point through two control points to the later one; how fast it moves
/// along the curve is the easing of a temporal interpolater. Control points
/// are absolute positions, not offsets from the end points.
///
/// Its document name carries the curve, so that it survives as the plain
/// string an "interp" member holds: "bezr(<temporal name>;x1,y1,z1;x2,y2,z2)".
class VELAMEDIALIB_API BezierInterpolater : public Interpolater<Point3d> {
public:
    /// Throws ParserException "trying to read an unknown interpolater" when the
    /// temporal interpolater is not a kind that doubles have.
    BezierInterpolater(const Point3d& cp1, const Point3d& cp2, const std::string& temporalInterpolaterName);

    const Point3d& controlPoint1() const { return cp1_; }
    const Point3d& controlPoint2() const { return cp2_; }
    const std::string& temporalInterpolaterName() const { return temporal_->name(); }

    std::string asJson() const override;
    Point3d doInterpolate(const Point3d& a, const Point3d& b, const RationalTime& t0, const RationalTime& t1,
                          double t) const override;
    double ease(double u) const override { return temporal_->ease(u); }
    /// The same control points and the same temporal interpolater.
    bool sameAs(const Interpolater<Point3d>& other) const override;

    /// The point at curve parameter s in [0, 1].
    Point3d pointAt(const Point3d& a, const Point3d& b, double s) const;
    /// Reads the document name back; null when the text is not a Bézier name.
    static boost::shared_ptr<BezierInterpolater> fromName(const std::string& name);

private:
    Point3d cp1_, cp2_;
    boost::shared_ptr<Interpolater<double>> temporal_;
};

} // namespace VelaMediaLib
