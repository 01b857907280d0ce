// The project's operations on its sources.
#include <VelaMediaLib/commands/edits/InternalProject.h>

#include <VelaMediaLib/model/media/Group.h>
#include <VelaMediaLib/model/source/FileSystem.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/time/sync/NotifyDelay.h>

#include <algorithm>

namespace VelaMediaLib {

std::unique_ptr<NotifyDelay> InternalProject::delayed() const {
    // While the project delivers held-back notifications no delay may open:
    // an observer acting here is told at once.
    const boost::shared_ptr<const ThreadSafe> project = token().lock();
    if (!project || NotifyDelay::isNotifying(project)) return nullptr;
    return std::unique_ptr<NotifyDelay>(new NotifyDelay(project));
}

void InternalProject::setEditRate(const boost::rational<unsigned long>& rate) {
    if (rate.numerator() == 0) throw VelaMediaLibException("an edit rate must be greater than 0");
    SourceBin::Sources sources;
    std::vector<SourceRefit> refits;
    {
        // Every source must be able to take the rate before any does, and no
        // source comes or goes meanwhile.
        ScopedWriteLock lock(token());
        sources = sourceBin_->sources();
        for (const SourcePtr& source : sources) refits.push_back(source->refitFor(source->stats(), rate));
        for (size_t i = 0; i < sources.size(); ++i) sources[i]->swapIn(refits[i]);
        editRate_.storeEditRate(rate);
    }
    for (size_t i = 0; i < sources.size(); ++i) {
        sources[i]->settle(refits[i]);
        refitInstancesOf(sources[i]);
    }
    editRate_.notifyEditRateObservers(); // once everything has the rate
}

int InternalProject::unloadSource(const boost::shared_ptr<Source>& source) {
    // Checked under the bin's write lock: no clip is placed between the check and the removal.
    return sourceBin_->removeSource(source, [&] {
        if (timeline_->hasInstanceOf(source))
            throw VelaMediaLibException(
                "unable to remove a source that still has instances on the timeline.");
    });
}

void InternalProject::refitInstancesOf(const boost::shared_ptr<Source>& source) const {
    // A clip inside a stitched or unified clip is refitted by that clip, which
    // then fits its own limits to its parts'.
    std::vector<MediaPtr> refitted;
    for (const MediaPtr& media : timeline_->instancesOf(source)) {
        MediaPtr target = media;
        for (MediaPtr outer = Track::enclosingClipOf(*media); outer && !Group::asGroup(outer.get());
             outer = Track::enclosingClipOf(*outer))
            target = outer;
        if (std::find(refitted.begin(), refitted.end(), target) != refitted.end()) continue;
        target->mediaSourceChanged();
        refitted.push_back(target);
    }
}

bool InternalProject::bringSourceOnline(const boost::shared_ptr<Source>& source) {
    if (!sourceBin_->containsSource(source)) throw AddRemoveException("source is not in the source bin");
    if (source->isOnline()) return true;
    if (source->offlineStatus() != OfflineStatus::Reconnectable) return false;
    const std::unique_ptr<NotifyDelay> delay = delayed(); // the bin's sentries hear once all is back
    try {
        sourceBin_->changeSourcesFile(source, source->filename()); // whole or not at all
    } catch (const std::exception&) {
        return false; // the file changed again since it was asked about, or no longer matches
    }
    source->setOnline(true);
    refitInstancesOf(source);
    sourceBin_->notify();
    return true;
}

void InternalProject::dropSourceOffline(const boost::shared_ptr<Source>& source) {
    if (!sourceBin_->containsSource(source)) throw AddRemoveException("source is not in the source bin");
    source->setOnline(false);
    sourceBin_->notify();
}

void InternalProject::changeSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) {
    const std::unique_ptr<NotifyDelay> delay = delayed(); // sentries hear once the clips have their limits
    sourceBin_->changeSourcesFile(source, path);
    refitInstancesOf(source);
}

} // namespace VelaMediaLib
