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
    ScopedReadLock lock(projectLock());
    return keys_.count(source.get()) > 0;
}

bool SourceBin::isFileLoaded(const std::string& path) const { return bool(sourceForFile(path)); }

boost::shared_ptr<Source> SourceBin::sourceForFile(const std::string& path) const {
    // Most paths are normal already: they are looked up as they are, uncopied.
    if (isNormal(path)) {
        ScopedReadLock lock(projectLock());
        return lockedSourceForKey(path);
    }
    const std::string key = normalPath(path);
    ScopedReadLock lock(projectLock());
    return lockedSourceForKey(key);
}

boost::shared_ptr<Source> SourceBin::lockedSourceForKey(const std::string& key) const {
    const auto found = byPath_.find(key);
    return found == byPath_.end() ? boost::shared_ptr<Source>() : found->second;
}

boost::shared_ptr<Source> SourceBin::loadFile(const std::string& path) { return loadFileAtIndex(path, -1); }

boost::shared_ptr<Source> SourceBin::loadFileAtIndex(const std::string& path, int index, bool* added) {
    if (added) *added = false;
    if (const boost::shared_ptr<Source> loaded = sourceForFile(path)) return loaded;
    boost::shared_ptr<FileSystem> fileSystem;
    {
        ScopedReadLock lock(projectLock());
        if (index < -1 || index > static_cast<int>(sources_.size()))
            throw IndexException("source index out of range");
        fileSystem = fileSystem_;
    }
    // Reading the file may take long: no lock is held meanwhile.
    const boost::shared_ptr<Source> source = Source::create(rate_, projectMutex(), path, fileSystem);
    const std::string key = keyOf(path);
    std::vector<SourceRefit> settle;
    {
        ScopedWriteLock lock(projectMutex());
        // Another thread may have loaded the file meanwhile; its source wins.
        if (const boost::shared_ptr<Source> loaded = lockedSourceForKey(key)) return loaded;
        if (index > static_cast<int>(sources_.size())) throw IndexException("source index out of range");
        lockedInsert(source, key, index, settle);
    }
    for (const SourceRefit& refit : settle) source->settle(refit);
    if (added) *added = true;
    notify();
    return source;
}

void SourceBin::lockedInsert(const boost::shared_ptr<Source>& source, const std::string& key, int index,
                             std::vector<SourceRefit>& settle) {
    if (sources_.size() >= sources_.max_size()) throw VelaMediaLibException("list too long");
    // The project's rate may have changed since the source was made, or while
    // an undo step kept it: it comes in at the present one.
    const boost::shared_ptr<ProjectEditRate> rate = rate_.lock();
    if (rate && source->editRate() != rate->editRate()) {
        settle.push_back(source->refitFor(source->stats(), rate->editRate()));
        source->swapIn(settle.back());
    }
    const auto at =
        index < 0 || index > static_cast<int>(sources_.size()) ? sources_.end() : sources_.begin() + index;
    sources_.insert(at, source);
    byPath_[key] = source;
    keys_[source.get()] = key;
}

void SourceBin::insertSource(const boost::shared_ptr<Source>& source, int index) {
    if (!source) throw AddRemoveException("no source to insert");
    if (source->projectMutex().owner_before(projectMutex()) ||
        projectMutex().owner_before(source->projectMutex()))
        throw AddRemoveException("the source belongs to another project");
    if (index < -1) throw IndexException("source index out of range");
    std::vector<SourceRefit> settle;
    {
        ScopedWriteLock lock(projectMutex());
        const std::string key = keyOf(source->filename());
        if (keys_.count(source.get()) || byPath_.count(key))
            throw AddRemoveException("the source bin already holds a source of this file");
        lockedInsert(source, key, index, settle);
    }
    for (const SourceRefit& refit : settle) source->settle(refit);
    notify();
}

int SourceBin::removeSource(const boost::shared_ptr<const Source>& source,
                            const boost::function<void()>& check) {
    int index = -1;
    {
        ScopedWriteLock lock(projectMutex());
        const auto key = keys_.find(source.get());
        if (key == keys_.end()) throw AddRemoveException("source is not in the source bin");
        if (check) check();
        const auto found = std::find(sources_.begin(), sources_.end(), source);
        index = static_cast<int>(found - sources_.begin());
        byPath_.erase(key->second);
        keys_.erase(key);
        sources_.erase(found);
    }
    notify();
    return index;
}

void SourceBin::lockedRefile(const boost::shared_ptr<Source>& source, const std::string& key) {
    const auto held = keys_.find(source.get());
    if (held == keys_.end()) throw AddRemoveException("source is not in the source bin");
    const boost::shared_ptr<Source> holder = lockedSourceForKey(key);
    if (holder && holder != source) throw AddRemoveException("another source has the file: " + key);
    byPath_.erase(held->second);
    byPath_[key] = source;
    held->second = key;
}

void SourceBin::changeSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) {
    const boost::shared_ptr<MediaFileStats> stats = MediaFileStats::create(path, projectMutex());
    SourceRefit refit;
    {
        ScopedWriteLock lock(projectMutex());
        refit = source->refitFor(stats, source->editRate()); // may refuse: nothing changed yet
        lockedRefile(source, keyOf(path));
        source->swapIn(refit);
    }
    source->settle(refit);
    notify();
}

void SourceBin::renameSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) {
    bool renamed = false;
    {
        ScopedWriteLock lock(projectMutex());
        lockedRefile(source, keyOf(path));
        renamed = source->stats()->setFilenameUnnotified(path);
    }
    if (renamed) source->stats()->notify(); // the record's observers, outside the lock
    notify();
}

void SourceBin::setFileSystem(const boost::shared_ptr<FileSystem>& fileSystem) {
    ScopedWriteLock lock(projectMutex());
    fileSystem_ = fileSystem;
}

} // namespace VelaMediaLib
