#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/time/sync/ProjectToken.h>

#include <vector>

namespace VelaMediaLib {

class Track;
class DeletionPoint;
typedef boost::shared_ptr<const DeletionPoint> DeletionPointPtr;

/// What a ripple delete took out of one track, remembered at the tick where
/// the removed range began so that it can be put back: the range's length,
/// the clips it removed (the same objects, off every track, each with its
/// start counted from the point) and the points that stood inside the range
/// (counted the same way). A point is immutable: a ripple that moves it makes
/// a copy at the new tick, so a list of points is undone by giving it back.
///
/// Points are editing-session state, like the clipboard and the undo
/// history: the project document has no place for them (nor for clips that
/// are on no track), so they are not written and a document read back has
/// none.
class VELAMEDIALIB_API DeletionPoint : public VelaObject {
public:
    struct RemovedClip {
        MediaPtr media;
        VelaTime offset; // from the point's tick
    };
    struct InnerPoint {
        DeletionPointPtr point;
        VelaTime offset;
    };

    DeletionPoint(const boost::shared_ptr<Track>& track, VelaTime time, VelaTime length,
                  std::vector<RemovedClip> clips, std::vector<InnerPoint> inner,
                  boost::shared_ptr<const VelaObject> joins)
        : track_(track), time_(time), length_(length), clips_(std::move(clips)), inner_(std::move(inner)),
          joins_(std::move(joins)) {}

    /// The track the content came from; null once it has gone.
    boost::shared_ptr<Track> track() const { return track_.lock(); }
    VelaTime time() const { return time_; }
    VelaTime length() const { return length_; }
    const std::vector<RemovedClip>& clips() const { return clips_; }
    const std::vector<InnerPoint>& innerPoints() const { return inner_; }
    /// What the edit that made the point needs to join the cuts it made back
    /// together (its own business; the model only keeps it).
    const boost::shared_ptr<const VelaObject>& joins() const { return joins_; }
    /// The same point at another tick.
    DeletionPointPtr movedTo(VelaTime time) const {
        return DeletionPointPtr(new DeletionPoint(track(), time, length_, clips_, inner_, joins_));
    }

private:
    boost::weak_ptr<Track> track_;
    VelaTime time_;
    VelaTime length_;
    std::vector<RemovedClip> clips_;
    std::vector<InnerPoint> inner_;
    boost::shared_ptr<const VelaObject> joins_;
};

/// The deletion points of a timeline's tracks, at most one per track and
/// tick. Queries take the project's read lock, a change its write lock;
/// points of tracks that have gone are dropped when the list changes.
class VELAMEDIALIB_API DeletionPointList : public VelaObject, public ProjectToken {
public:
    explicit DeletionPointList(const boost::weak_ptr<const ThreadSafe>& token) : ProjectToken(token) {}

    /// The track's points, earliest first.
    std::vector<DeletionPointPtr> pointsOn(const Track& track) const;
    /// The track's point at the tick, or null.
    DeletionPointPtr pointAt(const Track& track, VelaTime time) const;
    /// Every point, track by track as they were set.
    std::vector<DeletionPointPtr> allPoints() const;
    /// Gives the track these points instead of the ones it had (sorted by
    /// tick). Throws VelaMediaLibException, changing nothing, for a point of
    /// another track or two points at one tick.
    void setPointsOn(const Track& track, std::vector<DeletionPointPtr> points);

private:
    std::vector<DeletionPointPtr> points_;
};

} // namespace VelaMediaLib
