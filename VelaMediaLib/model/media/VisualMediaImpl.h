#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/HotspotInfo.h>
#include <VelaMediaLib/model/media/MediaImpl.h>
#include <VelaMediaLib/model/media/VisualMedia.h>

#include <boost/optional.hpp>

namespace VelaMediaLib {

/// The shared implementation of visual clips. Its parameters are made when
/// first asked for; until then the transform queries use their defaults
/// (no translation, scale 1, no rotation or shear, anchor at the origin,
/// opacity 1, no crop).
class VELAMEDIALIB_API VisualMediaImpl : public MediaImpl, public virtual VisualMedia {
public:
    /// The part of the clip that holds the timing state.
    typedef MediaImpl ConcreteMediaImpl;

    static const char* const kParameterNames[8];

    VisualMediaImpl(const boost::weak_ptr<const ThreadSafe>& token,
                    const boost::weak_ptr<ProjectEditRate>& rate, const MediaState& initial,
                    EditorKind editor)
        : Media(token), VisualMedia(token), MediaImpl(token, rate, initial, editor) {}

    boost::shared_ptr<Parameter<Point3d>> translation() const override;
    boost::shared_ptr<Parameter<Point3d>> scale() const override;
    boost::shared_ptr<Parameter<Point3d>> rotation() const override;
    boost::shared_ptr<Parameter<Point3d>> shear() const override;
    boost::shared_ptr<Parameter<Point3d>> anchor() const override;
    boost::shared_ptr<Parameter<double>> opacity() const override;
    boost::shared_ptr<Parameter<Rect<float>>> geometryCropParam() const override;
    boost::shared_ptr<Parameter<Rect<float>>> sourceCropParam() const override;

    TransformMatrix transformAtTime(const RationalTime& time) const override {
        return calcTransformAtTime(time);
    }
    TransformMatrix calcTransformAtTime(const RationalTime& time) const override;
    TransformMatrix calcTransformAtTimeWithScale(const RationalTime& time,
                                                 const Point3d& scale) const override;
    TransformMatrix calcTransformAtTimeWithTranslation(const RationalTime& time,
                                                       const Point3d& translation) const override;
    TransformMatrix transformedTransformAtTime(const RationalTime& time,
                                               const TransformMatrix& outer) const override;
    TransformMatrix parentTransformAtGlobalTime(const RationalTime& time) const override;
    TransformMatrix mediaToModelTransformAtGlobalTime(const RationalTime& time) const override;
    TransformMatrix mediaToSurfaceTransformAtGlobalTime(const RationalTime& time,
                                                        const TransformMatrix& modelToSurface) const override;
    std::pair<Point3d, Point3d> mediaToModelScaleAndRotation(const RationalTime& time) const override;
    Rect<float> geometryCropRectAtTime(const RationalTime& time) const override;
    Rect<float> sourceCropRectAtTime(const RationalTime& time) const override;

    /// What a click on the clip does, if anything (see HotspotInfo).
    boost::optional<HotspotInfo> hotspot() const;
    /// An empty optional removes it. Notifies when changed.
    void setHotspot(const boost::optional<HotspotInfo>& hotspot);

protected:
    void copyFamilyContentInto(MediaImpl& clone) const override;
    void toJSONFamilyMembers(XMLOptions& options, int indent) const override;
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override;
    std::vector<std::string> defaultParameterNames() const override;

private:
    TransformMatrix compose(const Point3d& translation, const Point3d& rotation, const Point3d& shear,
                            const Point3d& scale, const Point3d& anchor) const;
    Point3d point(const char* name, const RationalTime& time, const Point3d& fallback) const {
        return parameterValueAtTime<Point3d>(name, time, fallback);
    }

    boost::optional<HotspotInfo> hotspot_; // guarded by the project's lock
};

} // namespace VelaMediaLib
