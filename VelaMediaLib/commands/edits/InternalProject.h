#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/CommandHandler.h>
#include <VelaMediaLib/base/Cloneable.h>
#include <VelaMediaLib/model/project/Project.h>
#include <VelaMediaLib/commands/edits/TrackMagnetizerAutoAttacher.h>
#include <VelaMediaLib/time/rational/SimpleProjectEditRate.h>
#include <VelaMediaLib/time/sync/SubjectWithMutex.h>

#include <atomic>
#include <boost/enable_shared_from_this.hpp>

namespace VelaMediaLib {

class NotifyDelay;

/// The one implementation of Project. It is its own command handler for
/// commands that need no more than its tracks.
class VELAMEDIALIB_API InternalProject : public VelaObject,
                                         public Cloneable,
                                         public Project,
                                         public ProjectIndependentCommandHandler,
                                         public boost::enable_shared_from_this<InternalProject> {
public:
    /// Makes the project under a shared pointer, then builds its parts in
    /// order: source bin, timeline, clipboard, command history, command
    /// observers, attributes.
    static boost::shared_ptr<InternalProject> create(const boost::rational<unsigned long>& rate);
    ~InternalProject() override;

    TimelinePtr timeline() const override { return timeline_; }
    boost::shared_ptr<SourceBin> sourceBin() const override { return sourceBin_; }
    boost::shared_ptr<ClipBoard> clipBoard() const override { return clipBoard_; }
    boost::shared_ptr<CommandHistory> commandHistory() const override { return history_; }
    boost::weak_ptr<const ThreadSafe> token() const override;
    boost::weak_ptr<ProjectEditRate> editRateToken() const override;

    // Edit rate, kept by a SimpleProjectEditRate (the one rule for every rate)
    boost::rational<unsigned long> editRate() const override { return editRate_.editRate(); }
    int32_t durationPerFrame() const override { return 1; }
    uint64_t editingUnit() const override { return 1; }
    int videoFrameRate() const override { return attributeValue<int>("videoFormatFrameRate", 30); }
    int audioSampleRate() const override { return attributeValue<int>("audioFormatSampleRate", 44100); }
    void attachEditRateObserver(Observer* observer) const override {
        editRate_.attachEditRateObserver(observer);
    }
    void detachEditRateObserver(Observer* observer) const override {
        editRate_.detachEditRateObserver(observer);
    }
    /// Every source of the bin takes the rate first (under one write lock, so
    /// no source comes or goes meanwhile), then the timeline's clips their
    /// streams' new limits, and the rate's observers are told last. Throws
    /// VelaMediaLibException "an edit rate must be greater than 0" for 0.
    void setEditRate(const boost::rational<unsigned long>& rate) override;

    // Observation
    void attach(Observer* observer) override { subject_.attach(observer); }
    void attachWithoutNotifyDelay(Observer* observer) override {
        subject_.attachWithoutNotifyDelay(observer);
    }
    void detach(Observer* observer) override { subject_.detach(observer); }
    void notify() override { subject_.notify(); }
    boost::weak_ptr<const void> lifeline() const override { return weak_from_this(); }

    // Settings, timeline, clipboard
    void setUndoLimit(int limit) override { history_->setUndoLimit(limit); }
    void setAuthorVersionInfo(const VersionInfo& info) override;
    VersionInfo authorVersionInfo() const override;
    boost::shared_ptr<GenericMixer> newMixer(const std::string& name) override {
        return timeline_->newMixer(name);
    }
    void removeMixer(const MixerPtr& mixer) override { timeline_->removeMixer(mixer); }
    void addClipping(const MixerPtr& clipping) override { clipBoard_->addClipping(clipping); }
    bool removeClipping(const MixerPtr& clipping) override { return clipBoard_->removeClipping(clipping); }

    // Sources
    boost::shared_ptr<Source> loadSource(const std::string& path) override {
        return loadSourceAtIndex(path, -1);
    }
    boost::shared_ptr<Source> loadSourceAtIndex(const std::string& path, int index) override {
        return sourceBin_->loadFileAtIndex(path, index);
    }
    int unloadSource(const boost::shared_ptr<Source>& source) override;
    bool bringSourceOnline(const boost::shared_ptr<Source>& source) override;
    void dropSourceOffline(const boost::shared_ptr<Source>& source) override;
    void changeSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) override;
    void renameSourcesFile(const boost::shared_ptr<Source>& source, const std::string& path) override {
        sourceBin_->renameSourcesFile(source, path);
    }
    void addSourceBinSentry(Observer* sentry) override { sourceBin_->attach(sentry); }
    /// The project acts on its own commands: load and unload reach it here.
    boost::shared_ptr<Project> project() override { return shared_from_this(); }

    // Commands
    /// Executes through the history; when that throws, the history is put back
    /// as it was before (failing which VelaMediaLibFatalException "Error
    /// occurred restoring command state after exception thrown during project
    /// execution") and the exception goes on.
    bool execute(const CommandPtr& command) override;
    void queueFollowUp(const CommandPtr& command) override { history_->queueFollowUp(command); }
    bool isReplaying() const override { return history_->isReplaying(); }
    bool undo() override;
    bool redo() override;
    void combineLastCommands() override { history_->combineLastCommands(); }
    void combineNextCommand() override { history_->combineNextCommand(); }
    void beginAutoCommandCombining() override { history_->beginAutoCommandCombining(); }
    void endAutoCommandCombining() override { history_->endAutoCommandCombining(); }
    bool isAutoCommandCombining() const override { return history_->isAutoCommandCombining(); }
    CommandHistoryState commandState() const override { return history_->state(); }
    void restoreCommandState(const CommandHistoryState& state) override { history_->restoreState(state); }
    void setCommandHandler(CommandHandler* handler) override { history_->setHandler(handler); }
    void attachCommandObserver(Observer* observer) override { commandSubject_->attach(observer); }
    void detachCommandObserver(Observer* observer) override { commandSubject_->detach(observer); }
    /// The default one, which edits the clips directly (it keeps nothing).
    EdgeModCommandHandler& edgeModCommandHandler() override;

    /// Root members: the project attributes it has ("title", "description",
    /// "author", "targetLoudness", "shouldApplyLoudnessNormalization",
    /// "videoFormatFrameRate", "audioFormatSampleRate", "allowSubFrameEditing"),
    /// "width", "height", "version", "editRate", "authoringClientName",
    /// "sourceBin", "timeline", "metadata".
    void toJSON(XMLOptions& options) const override;
    /// Defined with the readers (document/).
    boost::shared_ptr<Project> clone() const override;
    /// The "version" the writer puts into every document.
    static const char* documentVersion() { return "1.0"; }

    bool parsingProject() const override { return parsing_; }
    void setParsingProject(bool parsing) override { parsing_ = parsing; }

    /// The frame rate a new project of the rate shows: the rate itself when it
    /// is 25, 30, 50 or 60 frames a second, else 30.
    static int defaultVideoFrameRate(const boost::rational<unsigned long>& rate);
    /// The sample rate a new project of the rate plays: the rate itself when it
    /// is a common sample rate, else 44100.
    static int defaultAudioSampleRate(const boost::rational<unsigned long>& rate);

private:
    explicit InternalProject(const boost::rational<unsigned long>& rate);
    void init();
    /// The timeline's clips of the source take its streams' new ranges.
    void refitInstancesOf(const boost::shared_ptr<Source>& source) const;
    /// A notify delay on the project, unless it is delivering one.
    std::unique_ptr<NotifyDelay> delayed() const;

    SimpleProjectEditRate editRate_;
    PartSubject subject_{*this}; // notifies under the project's own token
    boost::shared_ptr<SourceBin> sourceBin_;
    TimelinePtr timeline_;
    boost::shared_ptr<ClipBoard> clipBoard_;
    boost::shared_ptr<CommandHistory> history_;
    std::unique_ptr<SubjectWithMutex> commandSubject_;
    std::unique_ptr<TrackMagnetizerAutoAttacher> magnetizers_; // goes before the timeline
    bool parsing_ = false;
};

} // namespace VelaMediaLib
