// The project's operations on its sources.
#include <VelaMediaLib/commands/edits/InternalProject.h>

#include <VelaMediaLib/model/source/FileSystem.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>

namespace VelaMediaLib {

void InternalProject::setEditRate(const boost::rational<unsigned long>& rate) {
    editRate_.setEditRate(rate);
    for (const SourcePtr& source : sourceBin_->sources()) source->setEditRate(editRate());
}

int InternalProject::unloadSource(const boost::shared_ptr<Source>& source) {
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
    boost::shared_ptr<MediaFileStats> stats;
    try {
        stats = MediaFileStats::create(path, token());
    } catch (const VelaMediaLibException&) {
        return false; // the file changed again since it was asked about
    }
    if (!stats->areCompatibleForChange(*source->stats())) return false;
    source->setStats(stats);
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
