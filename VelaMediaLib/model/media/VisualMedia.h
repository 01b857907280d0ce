#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/base/Rect.h>
#include <VelaMediaLib/model/media/Transformer.h>

namespace VelaMediaLib {

/// A clip that shows a picture: its placement on the canvas is keyframed
/// (translation, scale, rotation in radians about x, y and z, shear, anchor),
/// with an opacity and two crops (of the placed geometry and of the source
/// picture, each as insets left, top, right, bottom in pixels).
class VELAMEDIALIB_API VisualMedia : public virtual Media, public Transformer {
public:
    explicit VisualMedia(const boost::weak_ptr<const ThreadSafe>& token) : Media(token) {}

    virtual boost::shared_ptr<Parameter<Point3d>> translation() const = 0;
    virtual boost::shared_ptr<Parameter<Point3d>> scale() const = 0;
    virtual boost::shared_ptr<Parameter<Point3d>> rotation() const = 0;
    virtual boost::shared_ptr<Parameter<Point3d>> shear() const = 0;
    virtual boost::shared_ptr<Parameter<Point3d>> anchor() const = 0;
    virtual boost::shared_ptr<Parameter<double>> opacity() const = 0;
    virtual boost::shared_ptr<Parameter<Rect<float>>> geometryCropParam() const = 0;
    virtual boost::shared_ptr<Parameter<Rect<float>>> sourceCropParam() const = 0;

    /// translate * rotate (z, y, x) * shear * scale * translate(-anchor), at parametric time.
    virtual TransformMatrix calcTransformAtTime(const RationalTime& time) const = 0;
    virtual TransformMatrix calcTransformAtTimeWithScale(const RationalTime& time,
                                                         const Point3d& scale) const = 0;
    virtual TransformMatrix calcTransformAtTimeWithTranslation(const RationalTime& time,
                                                               const Point3d& translation) const = 0;
    /// The clip's transform placed inside an outer one.
    virtual TransformMatrix transformedTransformAtTime(const RationalTime& time,
                                                       const TransformMatrix& outer) const = 0;
    /// What the clip's containers do to it at a global time (identity on a track).
    virtual TransformMatrix parentTransformAtGlobalTime(const RationalTime& time) const = 0;
    /// From the clip's media to the project's model space at a global time.
    virtual TransformMatrix mediaToModelTransformAtGlobalTime(const RationalTime& time) const = 0;
    /// The same, then onto a drawing surface through the given model-to-surface transform.
    virtual TransformMatrix
    mediaToSurfaceTransformAtGlobalTime(const RationalTime& time,
                                        const TransformMatrix& modelToSurface) const = 0;
    /// The scale and rotation that reach the model at a global time.
    virtual std::pair<Point3d, Point3d> mediaToModelScaleAndRotation(const RationalTime& time) const = 0;
    virtual Rect<float> geometryCropRectAtTime(const RationalTime& time) const = 0;
    virtual Rect<float> sourceCropRectAtTime(const RationalTime& time) const = 0;
};

} // namespace VelaMediaLib
