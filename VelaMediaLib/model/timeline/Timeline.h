#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/AddObserverList.h>
#include <VelaMediaLib/time/parameters/Attributable.h>
#include <VelaMediaLib/model/media/IdentityTimeConverter.h>
#include <VelaMediaLib/base/CaptionAttributes.h>
#include <VelaMediaLib/model/timeline/GenericMixer.h>
#include <VelaMediaLib/model/timeline/DeletionPoint.h>
#include <VelaMediaLib/model/timeline/GenericTrack.h>
#include <VelaMediaLib/model/timeline/TimelineAddObserver.h>
#include <VelaMediaLib/model/media/Transformer.h>

namespace VelaMediaLib {

class Source;

/// The project's one time axis: named mixers ordered by name, the canvas
/// ("width", "height", "backgroundColor"), the camera that looks at it, the
/// markers and the master gain. Tracks are made and placed through it, and
/// it tells its add observers of every mixer, track and clip that comes or goes.
/// It places its content in model space unchanged (TransformerImpl).
///
/// The camera: eye, look-at point and up vector (points), vertical field of
/// view in degrees (45), near and far clip distances (1, 100000). The default
/// eye sits on the z axis at the distance from which the field of view shows
/// the canvas height exactly.
class VELAMEDIALIB_API Timeline : public SubProject,
                                  public Cloneable,
                                  public ObjectSubject,
                                  public Temporal,
                                  public Parametric,
                                  public TransformerImpl,
                                  public IdentityTimeConverter,
                                  public MixerAddObserver,
                                  public Attributable,
                                  public boost::enable_shared_from_this<Timeline> {
public:
    static boost::shared_ptr<Timeline> create(const boost::weak_ptr<const ThreadSafe>& token,
                                              int width = 1920, int height = 1080);
    ~Timeline() override;
    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }

    // Mixers
    MixerPtr mixer(const std::string& name) const;
    /// The mixer whose name comes first, or null.
    MixerPtr mixer() const;
    std::vector<std::string> mixerNames() const;
    /// The mixers in name order, read under one lock.
    std::vector<MixerPtr> mixers() const;
    boost::shared_ptr<GenericMixer> newMixer(const std::string& name);
    /// Throws AddRemoveException when the name is taken or the mixer already
    /// belongs to a timeline (this one under another name included).
    void addMixer(const std::string& name, const MixerPtr& mixer);
    /// Throws VelaMediaLibException "unable to find mixer".
    void removeMixer(const MixerPtr& mixer);

    // Tracks
    boost::shared_ptr<GenericTrack> newTrack() const;
    /// Places the track in one of this timeline's mixers (see GenericMixer::addTrack).
    void addTrack(const MixerPtr& mixer, const TrackPtr& track, int index = -1);
    /// Throws VelaMediaLibException "track doesn't belong to project" when no
    /// mixer of this timeline holds the track.
    RemoveTrackInfo removeTrack(const MixerPtr& mixer, const TrackPtr& track);
    size_t numTracks() const;

    // Clips
    std::vector<MediaPtr> allMedias() const;
    /// Every clip at the tick, track by track (both of two touching clips);
    /// a group is followed by the clips it plays there, at any depth.
    std::vector<MediaPtr> allMediasAtTime(VelaTime time) const;
    /// The same clips, each with the tick as its own parametric time (exact).
    std::vector<Track::MediaAtTime> allMediasAndTimesAtTime(VelaTime time) const;
    template <typename Kind>
    std::vector<boost::shared_ptr<Kind>> instancesOf() const {
        std::vector<boost::shared_ptr<Kind>> found;
        for (const MediaPtr& media : allMedias())
            if (const auto kind = boost::dynamic_pointer_cast<Kind>(media)) found.push_back(kind);
        return found;
    }
    template <typename Kind>
    bool hasInstanceOf() const {
        return !instancesOf<Kind>().empty();
    }
    /// The sources the clips play, each once.
    std::vector<boost::shared_ptr<const Source>> allSources() const;
    /// The clips that play the source.
    std::vector<MediaPtr> instancesOf(const boost::shared_ptr<const Source>& source) const;
    /// Whether a clip plays the source: on the timeline, or held by a
    /// deletion point to be put back (so the source must stay loaded).
    bool hasInstanceOf(const boost::shared_ptr<const Source>& source) const;
    /// Gives every clip that plays `from` the source `to`; returns how many
    /// changed. Throws, changing no clip, when one cannot play `to` (see
    /// Sourceable::checkSource).
    size_t swapSourceForTimelineMedias(const boost::shared_ptr<const Source>& from,
                                       const boost::shared_ptr<const Source>& to);

    // Time
    VelaTime startTime() const override { return 0; }
    VelaTime endTime() const override;
    VelaTime duration() const override { return endTime(); }
    Range<VelaTime> timeRange() const override { return Range<VelaTime>(0, endTime()); }
    VelaTime endTimeNotIncludingHiddenAndMutedTracks() const;
    /// What ripple deletes took out of the tracks, to be put back (not written).
    const boost::shared_ptr<DeletionPointList>& deletionPoints() const { return deletionPoints_; }

    // Canvas, camera, markers, sound
    boost::shared_ptr<Attribute<int>> attributeWidth() const { return attribute<int>("width"); }
    boost::shared_ptr<Attribute<int>> attributeHeight() const { return attribute<int>("height"); }
    boost::shared_ptr<Attribute<TemplatedColor<int>>> backgroundColor() const {
        return attribute<TemplatedColor<int>>("backgroundColor");
    }
    boost::shared_ptr<Attribute<double>> gain() const { return attribute<double>("gain"); }
    boost::shared_ptr<Attribute<bool>> legacyAttenuateAudioMixAttribute() const {
        return attribute<bool>("legacyAttenuateAudioMix");
    }
    CaptionAttributes captionAttributes() const;
    void setCaptionAttributes(const CaptionAttributes& attributes);
    boost::shared_ptr<Parameter<Point3d>> eyePositionParam() const {
        return typedParameter<Point3d>("eyePosition");
    }
    boost::shared_ptr<Parameter<Point3d>> eyeLookAtPositionParam() const {
        return typedParameter<Point3d>("eyeLookAtPosition");
    }
    boost::shared_ptr<Parameter<Point3d>> eyeUpVectorParam() const {
        return typedParameter<Point3d>("eyeUpVector");
    }
    boost::shared_ptr<Parameter<double>> fovParam() const { return typedParameter<double>("fov"); }
    boost::shared_ptr<Parameter<double>> nearClipDistanceParam() const {
        return typedParameter<double>("nearClipDistance");
    }
    boost::shared_ptr<Parameter<double>> farClipDistanceParam() const {
        return typedParameter<double>("farClipDistance");
    }
    /// Markers: keyframes whose values are the markers' names; an empty name marks nothing.
    boost::shared_ptr<Parameter<std::string>> markerParam() const {
        return typedParameter<std::string>("markers");
    }
    /// World to camera, right-handed (the camera looks down its -z axis).
    TransformMatrix cameraTransformAtTime(const RationalTime& time) const;
    /// Camera to clip space, right-handed (depth -1 near to 1 far).
    TransformMatrix projectionTransformAtTime(const RationalTime& time) const;
    /// The same, left-handed (the camera looks down +z; depth 0 near to 1 far).
    TransformMatrix cameraTransformAtTimeLH(const RationalTime& time) const;
    TransformMatrix projectionTransformAtTimeLH(const RationalTime& time) const;
    /// World to canvas pixels (origin top left): viewport * projection * camera.
    TransformMatrix calcScreenTransformAtTime(const RationalTime& time) const;

    // Document (TimelineDocument.cpp)
    /// The timeline's object, closed at indent: "id", "sceneTrack" (one scene
    /// per mixer in name order, each {"velaml": {"tracks": [...]}, "ident":
    /// the mixer's name}), "trackAttributes" (the first mixer's tracks),
    /// "captionAttributes", "backgroundColor", "gain",
    /// "legacyAttenuateAudioMix", "parameters", "metadata".
    void toJSON(XMLOptions& options, int indent) const;

    // Observers
    void attachAddObserver(TimelineAddObserver* observer);
    void detachAddObserver(TimelineAddObserver* observer);
    void onMixerAddTrack(Mixer& mixer, const TrackPtr& track) override;
    void onMixerRemoveTrack(Mixer& mixer, const TrackPtr& track) override;
    void onMixerAddMedia(Mixer& mixer, Track& track, const MediaPtr& media) override;
    void onMixerRemoveMedia(Mixer& mixer, Track& track, const MediaPtr& media) override;

protected:
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override;
    std::vector<std::string> defaultParameterNames() const override;

private:
    explicit Timeline(const boost::weak_ptr<const ThreadSafe>& token);
    /// The camera's values at a time, as the projections need them.
    struct Camera {
        Point3d eye, lookAt, up;
        double fovDegrees, nearClip, farClip, aspect;
    };
    Camera cameraAtTime(const RationalTime& time) const;
    double defaultEyeDistance() const;
    /// Folds over the mixers under one read lock, so that a concurrent
    /// removeMixer cannot take one away between steps.
    template <typename Fold>
    void eachMixer(Fold fold) const {
        ScopedReadLock lock(projectLock());
        for (const auto& entry : mixers_) fold(*entry.second);
    }

    std::map<std::string, MixerPtr> mixers_;
    AddObserverList<TimelineAddObserver> addObservers_;
    CaptionAttributes captions_;
    boost::shared_ptr<DeletionPointList> deletionPoints_;
};

typedef boost::shared_ptr<Timeline> TimelinePtr;

} // namespace VelaMediaLib
