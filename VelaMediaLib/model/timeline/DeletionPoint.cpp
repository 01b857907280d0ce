#include <VelaMediaLib/model/timeline/DeletionPoint.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <algorithm>

namespace VelaMediaLib {

namespace {

bool isOn(const DeletionPoint& point, const Track& track) { return point.track().get() == &track; }

} // namespace

std::vector<DeletionPointPtr> DeletionPointList::pointsOn(const Track& track) const {
    ScopedReadLock lock(projectLock());
    std::vector<DeletionPointPtr> found;
    for (const DeletionPointPtr& point : points_)
        if (isOn(*point, track)) found.push_back(point);
    return found;
}

DeletionPointPtr DeletionPointList::pointAt(const Track& track, VelaTime time) const {
    ScopedReadLock lock(projectLock());
    for (const DeletionPointPtr& point : points_)
        if (point->time() == time && isOn(*point, track)) return point;
    return DeletionPointPtr();
}

std::vector<DeletionPointPtr> DeletionPointList::allPoints() const {
    ScopedReadLock lock(projectLock());
    return points_;
}

void DeletionPointList::setPointsOn(const Track& track, std::vector<DeletionPointPtr> points) {
    std::sort(points.begin(), points.end(),
              [](const DeletionPointPtr& a, const DeletionPointPtr& b) { return a->time() < b->time(); });
    for (size_t i = 0; i < points.size(); ++i) {
        if (!isOn(*points[i], track)) throw VelaMediaLibException("a deletion point of another track");
        if (i > 0 && points[i - 1]->time() == points[i]->time())
            throw VelaMediaLibException("two deletion points at one tick of a track");
    }
    ScopedWriteLock lock(projectMutex());
    std::vector<DeletionPointPtr> kept;
    for (const DeletionPointPtr& point : points_)
        if (point->track() && !isOn(*point, track)) kept.push_back(point);
    kept.insert(kept.end(), points.begin(), points.end());
    points_.swap(kept);
}

} // namespace VelaMediaLib
