#include <VelaMediaLib/commands/edits/InternalProject.h>

#include <VelaMediaLib/commands/edits/EdgeModCommandHandler.h>

#include <algorithm>

namespace VelaMediaLib {
namespace {

const char* const kClientName = "authoringClientName:name";
const char* const kClientPlatform = "authoringClientName:platform";
const char* const kClientVersion = "authoringClientName:version";

bool wholeRateIn(const boost::rational<unsigned long>& rate, std::initializer_list<unsigned long> choices) {
    return rate.denominator() == 1 &&
           std::find(choices.begin(), choices.end(), rate.numerator()) != choices.end();
}

} // namespace

boost::shared_ptr<Project> Project::create(unsigned long numerator, unsigned long denominator) {
    return create(SimpleProjectEditRate::rateOf(numerator, denominator));
}

boost::shared_ptr<Project> Project::create(const boost::rational<unsigned long>& rate) {
    return InternalProject::create(rate);
}

InternalProject::InternalProject(const boost::rational<unsigned long>& rate) : editRate_(rate) {}

InternalProject::~InternalProject() { magnetizers_.reset(); }

boost::shared_ptr<InternalProject> InternalProject::create(const boost::rational<unsigned long>& rate) {
    const boost::shared_ptr<InternalProject> project(new InternalProject(rate));
    project->init();
    return project;
}

int InternalProject::defaultVideoFrameRate(const boost::rational<unsigned long>& rate) {
    return wholeRateIn(rate, {25, 30, 50, 60}) ? int(rate.numerator()) : 30;
}

int InternalProject::defaultAudioSampleRate(const boost::rational<unsigned long>& rate) {
    return wholeRateIn(rate, {16000, 22050, 24000, 32000, 44100, 48000, 64000, 88200, 96000})
               ? int(rate.numerator())
               : 44100;
}

void InternalProject::init() {
    const boost::weak_ptr<const ThreadSafe> projectToken = token();
    setMetaDataProjectMutex(projectToken); // the one token of the project's own parts
    editRate_.setProjectMutex(projectToken);
    subject_.setOwner(this);
    sourceBin_.reset(new SourceBin(projectToken, editRateToken()));
    timeline_ = Timeline::create(projectToken);
    clipBoard_.reset(new ClipBoard(projectToken));
    // The project is the history's handler; the history holds it alive
    // through the token for each step and refuses once it has gone.
    history_.reset(new CommandHistory(this, projectToken));
    commandSubject_.reset(new SubjectWithMutex(projectToken));
    magnetizers_.reset(new TrackMagnetizerAutoAttacher(timeline_, *this));
    addAttribute<std::string>("author", std::string());
    addAttribute<std::string>("title", std::string());
    addAttribute<std::string>("description", std::string());
    addAttribute<double>("targetLoudness", -18.0);
    addAttribute<bool>("shouldApplyLoudnessNormalization", false);
    addAttribute<bool>("allowSubFrameEditing", true);
    addAttribute<int>("videoFormatFrameRate", defaultVideoFrameRate(editRate()));
    addAttribute<int>("audioFormatSampleRate", defaultAudioSampleRate(editRate()));
}

boost::weak_ptr<const ThreadSafe> InternalProject::token() const {
    return boost::shared_ptr<const ThreadSafe>(shared_from_this());
}

boost::weak_ptr<ProjectEditRate> InternalProject::editRateToken() const {
    const boost::shared_ptr<const InternalProject> self = shared_from_this();
    return boost::shared_ptr<ProjectEditRate>(boost::const_pointer_cast<InternalProject>(self));
}

void InternalProject::setAuthorVersionInfo(const VersionInfo& info) {
    addMetaData(kClientName, info.clientName);
    addMetaData(kClientPlatform, info.platform);
    addMetaData(kClientVersion, info.clientVersion);
}

VersionInfo InternalProject::authorVersionInfo() const {
    VersionInfo info;
    info.clientName = metaDataValue(kClientName);
    info.platform = metaDataValue(kClientPlatform);
    info.clientVersion = metaDataValue(kClientVersion);
    return info;
}

// The history folds the command as asked and runs its follow-ups; its
// stacks are whole whenever it throws, and are put back all the same. The
// follow-ups waiting from idle time run first, as steps of their own, so the
// state saved here already holds them.
bool InternalProject::execute(const CommandPtr& command) {
    history_->runFollowUps();
    const CommandHistoryState saved = history_->state();
    bool done = false;
    try {
        done = history_->execute(command);
    } catch (...) {
        try {
            history_->restoreState(saved);
        } catch (...) {
            throw VelaMediaLibFatalException(
                "Error occurred restoring command state after exception thrown during project execution");
        }
        throw;
    }
    commandSubject_->notify();
    return done;
}

EdgeModCommandHandler& InternalProject::edgeModCommandHandler() {
    return EdgeModCommandHandler::defaultHandler();
}

bool InternalProject::undo() {
    const bool done = history_->undo();
    commandSubject_->notify();
    return done;
}

bool InternalProject::redo() {
    const bool done = history_->redo();
    commandSubject_->notify();
    return done;
}

} // namespace VelaMediaLib
