#include <VelaMediaLib/model/media/VisualMediaImpl.h>

#include <VelaMediaLib/time/parameters/InterpolatingParam.h>

namespace VelaMediaLib {
namespace {

const Point3d kNoOffset(0, 0, 0);
const Point3d kUnitScale(1, 1, 1);
const Rect<float> kNoCrop(0, 0, 0, 0);

} // namespace

const char* const VisualMediaImpl::kParameterNames[8] = {
    "translation", "scale", "rotation", "shear", "anchor", "opacity", "geometryCropParam", "sourceCropParam"};

std::vector<std::string> VisualMediaImpl::defaultParameterNames() const {
    return std::vector<std::string>(std::begin(kParameterNames), std::end(kParameterNames));
}

boost::shared_ptr<ParameterInterface> VisualMediaImpl::createDefaultParameter(const std::string& name) const {
    const boost::weak_ptr<const ThreadSafe> token = projectMutex();
    boost::shared_ptr<ParameterInterface> made;
    if (name == "scale")
        made = InterpolatingParam<Point3d>::create(token, name, kUnitScale);
    else if (name == "translation" || name == "rotation" || name == "shear" || name == "anchor")
        made = InterpolatingParam<Point3d>::create(token, name, kNoOffset);
    else if (name == "opacity")
        made = InterpolatingParam<double>::create(token, name, 1.0);
    else if (name == "geometryCropParam" || name == "sourceCropParam")
        made = InterpolatingParam<Rect<float>>::create(token, name, kNoCrop);
    else
        return MediaImpl::createDefaultParameter(name);
    made->setTimeScalable(sharedTimeScale());
    return made;
}

boost::shared_ptr<Parameter<Point3d>> VisualMediaImpl::translation() const {
    return typedParameter<Point3d>("translation");
}
boost::shared_ptr<Parameter<Point3d>> VisualMediaImpl::scale() const {
    return typedParameter<Point3d>("scale");
}
boost::shared_ptr<Parameter<Point3d>> VisualMediaImpl::rotation() const {
    return typedParameter<Point3d>("rotation");
}
boost::shared_ptr<Parameter<Point3d>> VisualMediaImpl::shear() const {
    return typedParameter<Point3d>("shear");
}
boost::shared_ptr<Parameter<Point3d>> VisualMediaImpl::anchor() const {
    return typedParameter<Point3d>("anchor");
}
boost::shared_ptr<Parameter<double>> VisualMediaImpl::opacity() const {
    return typedParameter<double>("opacity");
}
boost::shared_ptr<Parameter<Rect<float>>> VisualMediaImpl::geometryCropParam() const {
    return typedParameter<Rect<float>>("geometryCropParam");
}
boost::shared_ptr<Parameter<Rect<float>>> VisualMediaImpl::sourceCropParam() const {
    return typedParameter<Rect<float>>("sourceCropParam");
}

TransformMatrix VisualMediaImpl::compose(const Point3d& translation, const Point3d& rotation,
                                         const Point3d& shear, const Point3d& scale,
                                         const Point3d& anchor) const {
    return TransformMatrix::translation(translation.x, translation.y, translation.z) *
           TransformMatrix::rotationZ(rotation.z) * TransformMatrix::rotationY(rotation.y) *
           TransformMatrix::rotationX(rotation.x) * TransformMatrix::shearing(shear.x, shear.y) *
           TransformMatrix::scaling(scale.x, scale.y, scale.z) *
           TransformMatrix::translation(-anchor.x, -anchor.y, -anchor.z);
}

TransformMatrix VisualMediaImpl::calcTransformAtTime(const RationalTime& time) const {
    return calcTransformAtTimeWithScale(time, point("scale", time, kUnitScale));
}

TransformMatrix VisualMediaImpl::calcTransformAtTimeWithScale(const RationalTime& time,
                                                              const Point3d& scale) const {
    return compose(point("translation", time, kNoOffset), point("rotation", time, kNoOffset),
                   point("shear", time, kNoOffset), scale, point("anchor", time, kNoOffset));
}

TransformMatrix VisualMediaImpl::calcTransformAtTimeWithTranslation(const RationalTime& time,
                                                                    const Point3d& translation) const {
    return compose(translation, point("rotation", time, kNoOffset), point("shear", time, kNoOffset),
                   point("scale", time, kUnitScale), point("anchor", time, kNoOffset));
}

TransformMatrix VisualMediaImpl::transformedTransformAtTime(const RationalTime& time,
                                                            const TransformMatrix& outer) const {
    return outer * calcTransformAtTime(time);
}

// A visual container (a group) places its content with its own transform.
TransformMatrix VisualMediaImpl::parentTransformAtGlobalTime(const RationalTime& time) const {
    TransformMatrix parentTransform;
    parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
        if (const auto visual = boost::dynamic_pointer_cast<VisualMedia>(parent))
            parentTransform = visual->mediaToModelTransformAtGlobalTime(time);
    });
    return parentTransform;
}

TransformMatrix VisualMediaImpl::mediaToModelTransformAtGlobalTime(const RationalTime& time) const {
    return parentTransformAtGlobalTime(time) * calcTransformAtTime(fromGlobalToParametricTime(time));
}

TransformMatrix
VisualMediaImpl::mediaToSurfaceTransformAtGlobalTime(const RationalTime& time,
                                                     const TransformMatrix& modelToSurface) const {
    return modelToSurface * mediaToModelTransformAtGlobalTime(time);
}

std::pair<Point3d, Point3d> VisualMediaImpl::mediaToModelScaleAndRotation(const RationalTime& time) const {
    const RationalTime local = fromGlobalToParametricTime(time);
    Point3d scale = point("scale", local, kUnitScale), rotation = point("rotation", local, kNoOffset);
    parentVisitor([&](const boost::shared_ptr<SubTimeline>& parent) {
        if (const auto visual = boost::dynamic_pointer_cast<VisualMedia>(parent)) {
            const std::pair<Point3d, Point3d> outer = visual->mediaToModelScaleAndRotation(time);
            scale = Point3d(scale.x * outer.first.x, scale.y * outer.first.y, scale.z * outer.first.z);
            rotation = Point3d(rotation.x + outer.second.x, rotation.y + outer.second.y,
                               rotation.z + outer.second.z);
        }
    });
    return std::make_pair(scale, rotation);
}

Rect<float> VisualMediaImpl::geometryCropRectAtTime(const RationalTime& time) const {
    return parameterValueAtTime<Rect<float>>("geometryCropParam", time, kNoCrop);
}

Rect<float> VisualMediaImpl::sourceCropRectAtTime(const RationalTime& time) const {
    return parameterValueAtTime<Rect<float>>("sourceCropParam", time, kNoCrop);
}

} // namespace VelaMediaLib
