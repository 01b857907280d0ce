#include <VelaMediaLib/model/project/SourceBin.h>

#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <algorithm>

namespace VelaMediaLib {

SourceBin::SourceBin(const boost::weak_ptr<const ThreadSafe>& token,
                     const boost::weak_ptr<ProjectEditRate>& rate)
    : ObjectSubject(token), MetaDatable(token), rate_(rate) {}

SourceBin::~SourceBin() = default;

namespace {

/// The path without empty and "." segments, each ".." taking the segment
/// before it (as text: links are not followed).
std::string normalPath(const std::string& path) {
    const bool absolute = !path.empty() && path[0] == '/';
    std::vector<std::string> parts;
    size_t begin = 0;
    while (begin <= path.size()) {
        const size_t end = std::min(path.find('/', begin), path.size());
        const std::string part = path.substr(begin, end - begin);
        if (part == ".." && !parts.empty() && parts.back() != "..") {
            parts.pop_back();
        } else if (!part.empty() && part != "." && !(part == ".." && absolute && parts.empty())) {
            parts.push_back(part);
        }
        begin = end + 1;
    }
    std::string normal = absolute ? "/" : "";
    for (size_t i = 0; i < parts.size(); ++i) normal += (i ? "/" : "") + parts[i];
    return normal.empty() ? "." : normal;
}

} // namespace

bool SourceBin::isNormal(const std::string& path) {
    return !path.empty() && path[0] != '.' && path.back() != '/' && path.find("//") == std::string::npos &&
           path.find("/.") == std::string::npos;
}

std::string SourceBin::keyOf(const std::string& path) { return isNormal(path) ? path : normalPath(path); }

SourceBin::Sources SourceBin::sources() const {
    ScopedReadLock lock(projectLock());
    return sources_;
}

size_t SourceBin::numSources() const {
    ScopedReadLock lock(projectLock());
    return sources_.size();
}

int SourceBin::indexOfSource(const boost::shared_ptr<const Source>& source) const {
    ScopedReadLock lock(projectLock());
    const auto found = std::find(sources_.begin(), sources_.end(), source);
    return found == sources_.end() ? -1 : static_cast<int>(found - sources_.begin());
}

bool SourceBin::containsSource(const boost::shared_ptr<const Source>& source) const {
    return indexOfSource(source) >= 0;
}

bool SourceBin::isFileLoaded(const std::string& path) const { return bool(sourceForFile(path)); }

boost::shared_ptr<Source> SourceBin::sourceForFile(const std::string& path) const {
    if (!isNormal(path)) return sourceForFile(normalPath(path));
    // Most paths are normal already: they are looked up as they are, uncopied.
    ScopedReadLock lock(projectLock());
    return lockedSourceForKey(path);
}

boost::shared_ptr<Source> SourceBin::lockedSourceForKey(const std::string& key) const {
    const auto found = byPath_.find(key);
    return found == byPath_.end() ? boost::shared_ptr<Source>() : found->second;
}

boost::shared_ptr<Source> SourceBin::loadFile(const std::string& path) { return loadFileAtIndex(path, -1); }

boost::shared_ptr<Source> SourceBin::loadFileAtIndex(const std::string& path, int index) {
    if (const boost::shared_ptr<Source> loaded = sourceForFile(path)) return loaded;
    if (index < -1 || index > static_cast<int>(numSources()))
        throw IndexException("source index out of range");
    boost::shared_ptr<FileSystem> fileSystem;
    {
        ScopedReadLock lock(projectLock());
        fileSystem = fileSystem_;
    }
    // Reading the file may take long: no lock is held meanwhile.
    const boost::shared_ptr<Source> source = Source::create(rate_, projectMutex(), path, fileSystem);
    {
        ScopedWriteLock lock(projectMutex());
        // Another thread may have loaded the file meanwhile; its source wins.
        if (const boost::shared_ptr<Source> loaded = lockedSourceForKey(keyOf(path))) return loaded;
        checkInsertable(*source, keyOf(path), index);
        sources_.insert(index < 0 ? sources_.end() : sources_.begin() + index, source);
        byPath_[keyOf(path)] = source;
    }
    notify();
    return source;
}

void SourceBin::checkInsertable(const Source& source, const std::string& key, int index) const {
    if (index < -1 || index > static_cast<int>(sources_.size()))
        throw IndexException("source index out of range");
    if (sources_.size() >= sources_.max_size()) throw VelaMediaLibException("list too long");
    if (byPath_.count(key) || std::find_if(sources_.begin(), sources_.end(), [&](const auto& held) {
                                  return held.get() == &source;
                              }) != sources_.end())
        throw AddRemoveException("the source bin already holds a source of this file");
}

void SourceBin::insertSource(const boost::shared_ptr<Source>& source, int index) {
    if (!source) throw AddRemoveException("no source to insert");
    if (source->projectMutex().owner_before(projectMutex()) ||
        projectMutex().owner_before(source->projectMutex()))
        throw AddRemoveException("the source belongs to another project");
    const std::string key = keyOf(source->filename());
    {
        ScopedWriteLock lock(projectMutex());
        checkInsertable(*source, key, index);
        sources_.insert(index < 0 ? sources_.end() : sources_.begin() + index, source);
        byPath_[key] = source;
    }
    notify();
}

int SourceBin::removeSource(const boost::shared_ptr<const Source>& source) {
    int index = -1;
    {
        ScopedWriteLock lock(projectMutex());
        const auto found = std::find(sources_.begin(), sources_.end(), source);
        if (found == sources_.end()) throw AddRemoveException("source is not in the source bin");
        index = static_cast<int>(found - sources_.begin());
        byPath_.erase(keyOf(source->filename()));
        sources_.erase(found);
    }
    notify();
    return index;
}

void SourceBin::checkHeld(const boost::shared_ptr<const Source>& source) const {
    if (!containsSource(source)) throw AddRemoveException("source is not in the source bin");
}

void SourceBin::rekey(const boost::shared_ptr<Source>& source, const std::string& oldKey) {
    byPath_.erase(oldKey);
    byPath_[keyOf(source->filename())] = source;
}

void SourceBin::changeSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) {
    checkHeld(source);
    const boost::shared_ptr<Source> holder = sourceForFile(path);
    if (holder && holder != source) throw AddRemoveException("another source has the file: " + path);
    const boost::shared_ptr<MediaFileStats> stats = MediaFileStats::create(path, projectMutex());
    if (!stats->areCompatibleForChange(*source->stats()))
        throw VelaMediaLibException("file is not compatible with the source's file: " + path);
    const std::string oldKey = keyOf(source->filename());
    source->setStats(stats);
    {
        ScopedWriteLock lock(projectMutex());
        rekey(source, oldKey);
    }
    notify();
}

void SourceBin::renameSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) {
    checkHeld(source);
    const boost::shared_ptr<Source> holder = sourceForFile(path);
    if (holder && holder != source) throw AddRemoveException("another source has the file: " + path);
    const std::string oldKey = keyOf(source->filename());
    source->setFilename(path);
    {
        ScopedWriteLock lock(projectMutex());
        rekey(source, oldKey);
    }
    notify();
}

void SourceBin::setFileSystem(const boost::shared_ptr<FileSystem>& fileSystem) {
    ScopedWriteLock lock(projectMutex());
    fileSystem_ = fileSystem;
}

} // namespace VelaMediaLib
