// The project's operations on its sources.
#include <VelaMediaLib/commands/edits/InternalProject.h>

#include <VelaMediaLib/model/source/FileSystem.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {

void InternalProject::setEditRate(const boost::rational<unsigned long>& rate) {
    const SourceBin::Sources sources = sourceBin_->sources();
    {
        // Every source must be able to take the rate before any does.
        ScopedWriteLock lock(token());
        std::vector<Source::Refit> refits;
        for (const SourcePtr& source : sources) refits.push_back(source->refitFor(source->stats(), rate));
        for (size_t i = 0; i < sources.size(); ++i) sources[i]->take(refits[i]);
    }
    editRate_.setEditRate(rate); // then the project, telling its observers outside the lock
    for (const SourcePtr& source : sources) refitInstancesOf(source);
}

int InternalProject::unloadSource(const boost::shared_ptr<Source>& source) {
    ScopedWriteLock lock(token()); // no clip may be placed between the check and the removal
    if (timeline_->hasInstanceOf(source))
        throw VelaMediaLibException("unable to remove a source that still has instances on the timeline.");
    return sourceBin_->removeSource(source);
}

void InternalProject::refitInstancesOf(const boost::shared_ptr<Source>& source) const {
    for (const MediaPtr& media : timeline_->instancesOf(source)) media->mediaSourceChanged();
}

bool InternalProject::bringSourceOnline(const boost::shared_ptr<Source>& source) {
    if (!sourceBin_->containsSource(source)) throw AddRemoveException("source is not in the source bin");
    if (source->isOnline()) return true;
    const std::string path = source->filename();
    if (source->offlineStatus() != OfflineStatus::Reconnectable) return false;
    try {
        source->setStats(MediaFileStats::create(path, token())); // whole or not at all
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
    sourceBin_->changeSourcesFile(source, path);
    refitInstancesOf(source);
}

} // namespace VelaMediaLib
