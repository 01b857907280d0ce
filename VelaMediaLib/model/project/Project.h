#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/framework/CommandExecutor.h>
#include <VelaMediaLib/commands/framework/CommandHistory.h>
#include <VelaMediaLib/document/format/VersionInfo.h>
#include <VelaMediaLib/time/parameters/Attributable.h>
#include <VelaMediaLib/model/timeline/ClipBoard.h>
#include <VelaMediaLib/model/project/SourceBin.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/rational/ProjectEditRate.h>

namespace VelaMediaLib {

class CommandHandler;
class EdgeModCommandHandler;
class Source;
class XMLOptions;

/// The document: the timeline, the source bin, the clipboard, the command
/// history and the settings, and the one reader-writer lock of the whole
/// model (the project is the token every object holds). Edits go through
/// execute, undo and redo.
class VELAMEDIALIB_API Project : public XMLable,
                                 public ThreadSafe,
                                 public ProjectEditRate,
                                 public Observable,
                                 public CommandExecutor,
                                 public MetaDatable,
                                 public Attributable {
public:
    /// The rate is reduced, a zero numerator giving 0/1 (as for every edit
    /// rate, see SimpleProjectEditRate::rateOf). Throws boost::bad_rational
    /// for a zero denominator, making no project.
    static boost::shared_ptr<Project> create(unsigned long numerator, unsigned long denominator);
    static boost::shared_ptr<Project> create(const boost::rational<unsigned long>& rate);

    virtual TimelinePtr timeline() const = 0;
    virtual boost::shared_ptr<SourceBin> sourceBin() const = 0;
    virtual boost::shared_ptr<ClipBoard> clipBoard() const = 0;
    /// The history may be kept past the project: it holds the project only
    /// through its token, and then refuses every step with
    /// VelaMediaLibException "the project of this command history has gone".
    virtual boost::shared_ptr<CommandHistory> commandHistory() const = 0;
    /// The project as every object's token.
    virtual boost::weak_ptr<const ThreadSafe> token() const = 0;
    /// The project's edit rate, as clips hold it.
    virtual boost::weak_ptr<ProjectEditRate> editRateToken() const = 0;

    // Settings
    virtual void setUndoLimit(int limit) = 0;
    /// Writes name, platform and version under "authoringClientName:name",
    /// "authoringClientName:platform" and "authoringClientName:version".
    virtual void setAuthorVersionInfo(const VersionInfo& info) = 0;
    virtual VersionInfo authorVersionInfo() const = 0;
    boost::shared_ptr<Attribute<std::string>> authorAttribute() const {
        return attribute<std::string>("author");
    }
    boost::shared_ptr<Attribute<std::string>> titleAttribute() const {
        return attribute<std::string>("title");
    }
    boost::shared_ptr<Attribute<std::string>> descriptionAttribute() const {
        return attribute<std::string>("description");
    }
    boost::shared_ptr<Attribute<double>> targetLoudnessAttribute() const {
        return attribute<double>("targetLoudness");
    }
    boost::shared_ptr<Attribute<bool>> shouldApplyLoudnessNormalizationAttribute() const {
        return attribute<bool>("shouldApplyLoudnessNormalization");
    }
    boost::shared_ptr<Attribute<bool>> allowSubFrameEditingAttribute() const {
        return attribute<bool>("allowSubFrameEditing");
    }
    boost::shared_ptr<Attribute<int>> videoFormatFrameRateAttribute() const {
        return attribute<int>("videoFormatFrameRate");
    }
    boost::shared_ptr<Attribute<int>> audioFormatSampleRateAttribute() const {
        return attribute<int>("audioFormatSampleRate");
    }
    static const char* voxaneMetaDataKey() { return "voxaneAttribute"; }
    boost::shared_ptr<Attribute<bool>> voxaneMetaDataAttribute() {
        return attributeOrAdd<bool>(voxaneMetaDataKey(), false);
    }

    // Timeline and clipboard
    virtual boost::shared_ptr<GenericMixer> newMixer(const std::string& name) = 0;
    virtual void removeMixer(const MixerPtr& mixer) = 0;
    virtual void addClipping(const MixerPtr& clipping) = 0;
    virtual bool removeClipping(const MixerPtr& clipping) = 0;

    // Sources. Loading and unloading go through LoadSourceCmd and
    // UnloadSourceCmd to be undoable; these act at once.

    /// The file's source: the one the bin holds, or a new one appended.
    virtual boost::shared_ptr<Source> loadSource(const std::string& path) = 0;
    /// The same, a new source inserted at the index (-1 appends); see SourceBin::loadFileAtIndex.
    virtual boost::shared_ptr<Source> loadSourceAtIndex(const std::string& path, int index) = 0;
    /// Takes the source out of the bin and returns where it was. Throws
    /// VelaMediaLibException "unable to remove a source that still has
    /// instances on the timeline." while a clip on the timeline plays it, and
    /// AddRemoveException when the bin does not hold it. Clips elsewhere (the
    /// clipboard, undo steps) keep the source alive but do not hold it in
    /// the bin: pasting one back plays a source the bin no longer lists.
    virtual int unloadSource(const boost::shared_ptr<Source>& source) = 0;
    /// Brings an offline source back when its file can be read again and
    /// its streams still match (its clips take their ranges); returns
    /// whether it is online.
    virtual bool bringSourceOnline(const boost::shared_ptr<Source>& source) = 0;
    virtual void dropSourceOffline(const boost::shared_ptr<Source>& source) = 0;
    /// See SourceBin::changeSourcesFile; the timeline's clips of the source
    /// take the new streams' ranges.
    virtual void changeSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) = 0;
    virtual void renameSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) = 0;
    /// The observer hears of every change of the source bin (load, unload,
    /// change or rename of a file), told as the bin's observers are.
    virtual void addSourceBinSentry(Observer* sentry) = 0;

    // Commands. execute (from CommandExecutor) first runs the follow-ups
    // queued while the history was idle (a host editing a magnetic track
    // directly), each a step of its own, then the command and its follow-ups.

    /// False when the command refused to undo: both stacks stay as they were.
    /// Throws VelaMediaLibException "no commands to undo".
    virtual bool undo() = 0;
    /// False when the command refused to redo. Throws "no commands to redo".
    virtual bool redo() = 0;
    virtual void combineLastCommands() = 0;
    /// The next command that takes effect is folded into the last step; the
    /// follow-ups it causes stay steps of their own. Kept by the history.
    virtual void combineNextCommand() = 0;
    /// Until the end, every step that takes effect after the first (follow-ups
    /// included) is folded into one.
    virtual void beginAutoCommandCombining() = 0;
    virtual void endAutoCommandCombining() = 0;
    virtual bool isAutoCommandCombining() const = 0;
    virtual CommandHistoryState commandState() const = 0;
    virtual void restoreCommandState(const CommandHistoryState& state) = 0;
    virtual void setCommandHandler(CommandHandler* handler) = 0;
    /// Observers told after every execute, undo and redo.
    virtual void attachCommandObserver(Observer* observer) = 0;
    virtual void detachCommandObserver(Observer* observer) = 0;
    /// What the edge-modification commands act through when given none.
    virtual EdgeModCommandHandler& edgeModCommandHandler() = 0;

    // Document
    /// Writes the whole project document (see InternalProjectDocument.cpp),
    /// taking the read lock per value: other threads may read meanwhile.
    virtual void toJSON(XMLOptions& options) const = 0;
    /// A project of its own with the same content: the document written and
    /// read back (ids are assigned anew). Throws as the reader does.
    virtual boost::shared_ptr<Project> clone() const = 0;

    /// True while a document is being read into the project.
    virtual bool parsingProject() const = 0;
    virtual void setParsingProject(bool parsing) = 0;
};

typedef boost::shared_ptr<Project> ProjectPtr;

} // namespace VelaMediaLib
