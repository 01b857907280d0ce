#include <VelaMediaLib/model/source/Source.h>

#include <VelaMediaLib/model/media/AMFile.h>
#include <VelaMediaLib/model/media/IMFile.h>
#include <VelaMediaLib/model/media/ScreenIMFile.h>
#include <VelaMediaLib/model/media/ScreenVMFile.h>
#include <VelaMediaLib/model/media/VMFile.h>
#include <VelaMediaLib/model/source/BoostFileSystem.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/timeline/Timeline.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>
#include <VelaMediaLib/time/sync/ReadWriteMutex.h>

#include <algorithm>
#include <ctime>

namespace VelaMediaLib {

namespace {

std::string utcNow() {
    const std::time_t now = std::time(nullptr);
    std::tm parts{};
#ifdef _WIN32
    gmtime_s(&parts, &now);
#else
    gmtime_r(&now, &parts);
#endif
    char text[32];
    std::strftime(text, sizeof text, "%Y-%m-%dT%H:%M:%SZ", &parts);
    return text;
}

/// Ticks of `from` as ticks of `to`, exactly.
SafeRational convertTicks(long long ticks, const boost::rational<unsigned long>& from,
                          const boost::rational<unsigned long>& to) {
    const SafeRational seconds =
        SafeRational(ticks) /
        SafeRational(static_cast<long long>(from.numerator()), static_cast<long long>(from.denominator()));
    return seconds *
           SafeRational(static_cast<long long>(to.numerator()), static_cast<long long>(to.denominator()));
}

/// A stream's range (ticks of its own rate) in ticks of the rate, exactly.
Range<SafeRational> streamRange(const Range<long long>& range, const boost::rational<unsigned long>& from,
                                const boost::rational<unsigned long>& to) {
    return Range<SafeRational>(convertTicks(range.first(), from, to), convertTicks(range.second(), from, to));
}

} // namespace

Source::Source(const boost::weak_ptr<ProjectEditRate>& rate, const boost::weak_ptr<const ThreadSafe>& token,
               const boost::shared_ptr<MediaFileStats>& stats,
               const boost::shared_ptr<FileSystem>& fileSystem)
    : MetaDatable(token), Attributable(token), rateToken_(rate), stats_(stats),
      fileSystem_(fileSystem ? fileSystem : BoostFileSystem::instance()) {
    const boost::shared_ptr<ProjectEditRate> project = rate.lock();
    if (!project) throw VelaMediaLibException("a source needs the edit rate of its project");
    editRate_ = project->editRate();
    if (editRate_.numerator() == 0) throw VelaMediaLibException("a source needs an edit rate greater than 0");
}

Source::~Source() = default;

boost::shared_ptr<Source> Source::create(const boost::weak_ptr<ProjectEditRate>& rate,
                                         const boost::weak_ptr<const ThreadSafe>& token,
                                         const std::string& path,
                                         const boost::shared_ptr<FileSystem>& fileSystem) {
    return create(rate, token, MediaFileStats::create(path, token), fileSystem);
}

boost::shared_ptr<Source> Source::create(const boost::weak_ptr<ProjectEditRate>& rate,
                                         const boost::weak_ptr<const ThreadSafe>& token,
                                         const boost::shared_ptr<MediaFileStats>& stats,
                                         const boost::shared_ptr<FileSystem>& fileSystem) {
    if (!stats) throw VelaMediaLibException("a source needs the stats of its file");
    MediaFileStats::checkContents(stats->contents());
    const boost::shared_ptr<Source> source(new Source(rate, token, stats, fileSystem));
    source->addMetaData(timeAddedMetaDataKey(), utcNow());
    source->addAttribute<bool>("shouldApplyLoudnessNormalization", false);
    source->buildStreamMedia();
    return source;
}

void Source::buildStreamMedia() {
    timeline_ = Timeline::create(projectMutex());
    const MixerPtr mixer = timeline_->newMixer("streams");
    const int streams = numTracks();
    streamMedia_.resize(static_cast<size_t>(streams));
    for (int stream = 0; stream < streams; ++stream) {
        const boost::shared_ptr<GenericTrack> track = timeline_->newTrack();
        timeline_->addTrack(mixer, track);
        streamMedia_[static_cast<size_t>(stream)] = makeStreamMedia(stream);
        if (const MediaPtr& media = streamMedia_[static_cast<size_t>(stream)]) track->addMedia(media, 0);
    }
}

MediaPtr Source::makeStreamMedia(int stream) const {
    const SourceLink link = SourceLink::ownedBy(shared_from_this(), stream);
    const Range<SafeRational> range = rationalTimeRangeForTrack(stream);
    if (range.second() <= SafeRational(0)) return MediaPtr(); // nothing to play
    const VelaTime length =
        std::max(RationalUtil::toVelaTime(RationalUtil::Round(range.second())), VelaTime(1));
    switch (stats()->trackType(stream)) {
    case TrackType::Video:
        return VMFile::create(link, FileMedia::wholeStreamState(link, VMFile::playsStream, 0));
    case TrackType::ScreenVideo:
        return ScreenVMFile::create(link, FileMedia::wholeStreamState(link, ScreenVMFile::playsStream, 0));
    case TrackType::Audio:
        return AMFile::create(link, FileMedia::wholeStreamState(link, AMFile::playsStream, 0));
    case TrackType::Image:
        return IMFile::create(link, AbstractIMFile::stillState(link, IMFile::playsStream, 0, length));
    case TrackType::ScreenImage:
        return ScreenIMFile::create(link,
                                    AbstractIMFile::stillState(link, ScreenIMFile::playsStream, 0, length));
    case TrackType::Unknown:
        break;
    }
    return MediaPtr();
}

boost::shared_ptr<MediaFileStats> Source::stats() const {
    ScopedReadLock lock(projectLock());
    return stats_;
}

std::string Source::filename() const { return stats()->filename(); }

int Source::numTracks() const { return stats()->numTracks(); }

OfflineStatus Source::offlineStatus() const {
    if (isOnline()) return OfflineStatus::Online;
    const std::string path = filename();
    if (!fileSystem_->exists(path)) return OfflineStatus::FileMissing;
    if (!fileSystem_->isReadable(path)) return OfflineStatus::FileUnreadable;
    return MediaFileStats::isFileOpenable(path) ? OfflineStatus::Reconnectable
                                                : OfflineStatus::StatsUnavailable;
}

boost::rational<unsigned long> Source::editRate() const {
    ScopedReadLock lock(projectLock());
    return editRate_;
}

Range<SafeRational> Source::rationalTimeRangeForTrack(int stream) const {
    ScopedReadLock lock(projectLock());
    // Only the range and its rate: every file clip edit asks this, and the
    // whole record of a stream carries its metadata strings.
    return streamRange(stats_->trackRange(stream), stats_->rangeEditRate(stream), editRate_);
}

Range<VelaTime> Source::timeRangeForTrack(int stream) const {
    const Range<SafeRational> exact = rationalTimeRangeForTrack(stream);
    const VelaTime start = RationalUtil::toVelaTime(RationalUtil::Floor(exact.first()));
    const VelaTime end = RationalUtil::toVelaTime(RationalUtil::Ceil(exact.first() + exact.second()));
    return Range<VelaTime>(start, end - start);
}

Range<VelaTime> Source::timeRange() const {
    ScopedReadLock lock(projectLock()); // one record for every stream
    VelaTime start = 0, end = 0;
    for (int stream = 0; stream < stats_->numTracks(); ++stream) {
        const Range<VelaTime> range = timeRangeForTrack(stream);
        start = stream == 0 ? range.first() : std::min(start, range.first());
        end = stream == 0 ? range.first() + range.second() : std::max(end, range.first() + range.second());
    }
    return Range<VelaTime>(start, end - start);
}

Rect<int> Source::trackRect(int stream) const { return stats()->trackRect(stream); }

MediaPtr Source::mediaForTrackNumber(int stream) const {
    if (stream < 0 || static_cast<size_t>(stream) >= streamMedia_.size())
        throw IndexException("stream index out of range");
    return streamMedia_[static_cast<size_t>(stream)];
}

boost::shared_ptr<ParameterInterface> Source::paramWithName(const std::string& name, int stream) const {
    const MediaPtr media = mediaForTrackNumber(stream);
    return media ? media->parameter(name) : boost::shared_ptr<ParameterInterface>();
}

std::vector<boost::shared_ptr<ParameterInterface>> Source::parameterVector(int stream) const {
    std::vector<boost::shared_ptr<ParameterInterface>> parameters;
    if (const MediaPtr media = mediaForTrackNumber(stream))
        for (const std::string& name : media->parameterNames()) parameters.push_back(media->parameter(name));
    return parameters;
}

SourceRefit Source::refitFor(const boost::shared_ptr<MediaFileStats>& stats,
                             const boost::rational<unsigned long>& rate) const {
    if (!stats) throw VelaMediaLibException("a source needs the stats of its file");
    const MediaFileStats::Contents contents = stats->contents();
    if (stats != this->stats() && !stats->areCompatibleForChange(*this->stats()))
        throw VelaMediaLibException("file is not compatible with the source's file: " + contents.filename);
    SourceRefit refit{stats, rate, {}, {}};
    for (size_t stream = 0; stream < streamMedia_.size(); ++stream) {
        const MediaPtr& media = streamMedia_[stream];
        if (!media || boost::dynamic_pointer_cast<AbstractIMFile>(media)) {
            refit.states.push_back(media ? media->state() : MediaState()); // stills have no extent
            continue;
        }
        const Range<SafeRational> range =
            streamRange(contents.tracks[stream].range, contents.tracks[stream].rangeEditRate, rate);
        if (range.second() <= SafeRational(0))
            throw VelaMediaLibException("stream " + std::to_string(stream) + " of " + contents.filename +
                                        " has no length at this edit rate");
        refit.states.push_back(FileMedia::wholeRangeState(range, 0));
    }
    return refit;
}

void Source::swapIn(SourceRefit& refit) {
    ScopedWriteLock lock(projectMutex()); // the caller's, taken again
    stats_ = refit.stats;
    editRate_ = refit.rate;
    refit.changed.assign(streamMedia_.size(), false);
    for (size_t stream = 0; stream < streamMedia_.size(); ++stream)
        if (const auto clip = boost::dynamic_pointer_cast<MediaImpl>(streamMedia_[stream]))
            refit.changed[stream] = clip->restoreStateUnnotified(refit.states[stream], 0);
}

void Source::settle(const SourceRefit& refit) {
    for (size_t stream = 0; stream < refit.changed.size(); ++stream)
        if (refit.changed[stream]) streamMedia_[stream]->notify();
}

void Source::setEditRate(const boost::rational<unsigned long>& rate) {
    SourceRefit refit;
    {
        ScopedWriteLock lock(projectMutex());
        refit = refitFor(stats(), rate);
        swapIn(refit);
    }
    settle(refit);
}

void Source::setStats(const boost::shared_ptr<MediaFileStats>& stats) {
    SourceRefit refit;
    {
        ScopedWriteLock lock(projectMutex());
        refit = refitFor(stats, editRate());
        swapIn(refit);
    }
    settle(refit);
}

void Source::setFilename(const std::string& path) { stats()->setFilename(path); }

} // namespace VelaMediaLib
