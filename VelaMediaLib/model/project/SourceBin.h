#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/time/parameters/MetaDatable.h>
#include <VelaMediaLib/time/sync/Subject.h>

#include <boost/enable_shared_from_this.hpp>
#include <boost/function.hpp>
#include <boost/shared_ptr.hpp>
#include <string>
#include <unordered_map>
#include <vector>

namespace VelaMediaLib {

class FileSystem;
class ProjectEditRate;
class Source;
class XMLOptions;
struct SourceRefit;

/// The project's imported sources, in the order they came, with an index by
/// file path. Paths are compared as text after removing empty and "."
/// segments and folding ".." ("a/./b", "a//b" and "c/../a/b" are one file);
/// links are not followed and case counts. Reads take the project's read lock,
/// changes its write lock; files are read with no lock held. Observers
/// attached to the bin (the project's source-bin sentries) hear of every
/// source loaded, unloaded, renamed or given another file.
class VELAMEDIALIB_API SourceBin : public VelaObject,
                                   public ObjectSubject,
                                   public MetaDatable,
                                   public boost::enable_shared_from_this<SourceBin> {
public:
    typedef std::vector<boost::shared_ptr<Source>> Sources;

    SourceBin(const boost::weak_ptr<const ThreadSafe>& token, const boost::weak_ptr<ProjectEditRate>& rate);
    ~SourceBin() override;
    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }

    /// Iterators over the list itself: the caller holds the project's read
    /// lock while it uses them, or edits on this thread only.
    Sources::const_iterator begin() const { return sources_.begin(); }
    Sources::const_iterator end() const { return sources_.end(); }
    Sources sources() const;
    /// The array of the sources' entries in bin order, closed at indent
    /// (SourceBinDocument.cpp).
    void toJSON(XMLOptions& options, int indent) const;
    size_t numSources() const;
    size_t size() const { return numSources(); }
    /// The source's position, or -1.
    int indexOfSource(const boost::shared_ptr<const Source>& source) const;
    bool containsSource(const boost::shared_ptr<const Source>& source) const;
    bool isFileLoaded(const std::string& path) const;
    /// The source of the file, or null.
    boost::shared_ptr<Source> sourceForFile(const std::string& path) const;

    /// The file's source: the one the bin holds, or a new one appended.
    boost::shared_ptr<Source> loadFile(const std::string& path);
    /// The same, a new source inserted at the index (-1 appends); `added`,
    /// when given, tells whether it was. Throws IndexException "source index
    /// out of range" and the exceptions of Source::create; the bin is then
    /// unchanged.
    boost::shared_ptr<Source> loadFileAtIndex(const std::string& path, int index, bool* added = nullptr);
    /// Puts a source in the bin at the index (-1 appends; past the end
    /// appends too), as a load and its redo do; it takes the project's
    /// present edit rate. Throws AddRemoveException when the bin holds it or
    /// another source of its file, or it belongs to another project, and
    /// "list too long" when full.
    void insertSource(const boost::shared_ptr<Source>& source, int index);
    /// Takes the source out; returns where it was. Throws AddRemoveException
    /// "source is not in the source bin", and what `check` throws: it runs
    /// under the write lock, just before the removal.
    int removeSource(const boost::shared_ptr<const Source>& source,
                     const boost::function<void()>& check = boost::function<void()>());
    /// Gives the source another file whose streams match its own (see
    /// MediaFileStats::areCompatibleForChange); its own clips take the new
    /// streams' ranges. Throws, changing nothing, VelaMediaLibException "file
    /// is not compatible with the source's file: <path>" (or when a stream
    /// would have no length), AddRemoveException when another source has the
    /// file or the bin does not hold the source, and the exceptions of
    /// MediaFileStats::create.
    void changeSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path);
    /// Records that the source's file now lives under another path; throws
    /// AddRemoveException as changeSourcesFile does.
    void renameSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path);

    /// The file system new sources ask about their files (the host's by default).
    void setFileSystem(const boost::shared_ptr<FileSystem>& fileSystem);

private:
    /// Whether normalising would leave the path as it is (the usual case).
    static bool isNormal(const std::string& path);
    static std::string keyOf(const std::string& path);
    boost::shared_ptr<Source> lockedSourceForKey(const std::string& key) const;
    /// Puts the source in the list and the index, bringing it to the
    /// project's present rate; the write lock is held. A source whose clips
    /// must settle once the lock is released adds its refit to `settle`.
    void lockedInsert(const boost::shared_ptr<Source>& source, const std::string& key, int index,
                      std::vector<SourceRefit>& settle);
    /// Checks that the bin holds the source and that no other source has the
    /// key, and files the source under it; the write lock is held.
    void lockedRefile(const boost::shared_ptr<Source>& source, const std::string& key);

    boost::weak_ptr<ProjectEditRate> rate_;
    boost::shared_ptr<FileSystem> fileSystem_;
    Sources sources_;
    std::unordered_map<std::string, boost::shared_ptr<Source>> byPath_;
    std::unordered_map<const Source*, std::string> keys_; // each source's key in byPath_
};

} // namespace VelaMediaLib
