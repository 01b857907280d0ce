#include <VelaMediaLib/model/media/FileMedia.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>

namespace VelaMediaLib {

SourceLink SourceLink::holding(const boost::shared_ptr<const Source>& source, int stream) {
    SourceLink link;
    link.strong = source;
    link.stream = stream;
    return link;
}

SourceLink SourceLink::ownedBy(const boost::shared_ptr<const Source>& source, int stream) {
    SourceLink link;
    link.weak = source;
    link.stream = stream;
    return link;
}

boost::shared_ptr<const Source> FileMedia::source() const {
    if (const auto held = boost::atomic_load(&strong_)) return held;
    return weak_.lock();
}

void FileMedia::setSource(const boost::shared_ptr<const Source>& source) {
    boost::atomic_store(&strong_, source);
}

namespace {

const Source& checkedSource(const SourceLink& link, StreamFilter plays) {
    const boost::shared_ptr<const Source> source = link.source();
    if (!source) throw VelaMediaLibException("a file clip needs a source");
    const boost::shared_ptr<MediaFileStats> stats = source->stats();
    const TrackType type = stats->trackType(link.stream); // checks the index
    if (!plays(type))
        throw TypeException("stream " + std::to_string(link.stream) + " of " + stats->filename() +
                            " is not of a kind this clip plays");
    return *source; // the link keeps it alive for the caller
}

} // namespace

void FileMedia::checkStream(const SourceLink& link, StreamFilter plays) { checkedSource(link, plays); }

boost::weak_ptr<const ThreadSafe> FileMedia::tokenOf(const SourceLink& link) {
    const boost::shared_ptr<const Source> source = link.source();
    return source ? source->projectMutex() : boost::weak_ptr<const ThreadSafe>();
}

boost::weak_ptr<ProjectEditRate> FileMedia::rateOf(const SourceLink& link) {
    const boost::shared_ptr<const Source> source = link.source();
    return source ? source->editRateToken() : boost::weak_ptr<ProjectEditRate>();
}

MediaState FileMedia::stateFor(const SourceLink& link, StreamFilter plays, VelaTime start,
                               const SafeRational& mediaStart, const SafeRational& mediaDuration,
                               const SafeRational& scalar) {
    const Source& source = checkedSource(link, plays);
    MediaState state = withStreamLimits(MediaState(), source, link.stream);
    if (mediaDuration <= SafeRational(0) || mediaStart < state.minMediaStart ||
        mediaStart + mediaDuration > state.maxMediaEnd)
        throw ValueException<const SafeRational>("media range outside the stream", mediaStart);
    state.start = start;
    state.mediaStart = mediaStart;
    state.mediaDuration = mediaDuration;
    state.scalar = scalar;
    state.duration = scalar > SafeRational(0)
                         ? RationalUtil::toVelaTime(RationalUtil::Round(mediaDuration * scalar))
                         : VelaTime(0);
    if (state.duration <= 0)
        throw ValueException<const SafeRational>("invalid duration after media stretch (<=0)", scalar);
    return state;
}

MediaState FileMedia::wholeStreamState(const SourceLink& link, StreamFilter plays, VelaTime start) {
    const Range<SafeRational> range = checkedSource(link, plays).rationalTimeRangeForTrack(link.stream);
    const SafeRational length = range.second();
    // A stream shorter than half a tick still gets a tick, played slower.
    const SafeRational ticks = std::max(RationalUtil::Round(length), SafeRational(1));
    return stateFor(link, plays, start, range.first(), length,
                    length > SafeRational(0) ? ticks / length : ticks);
}

MediaState FileMedia::withStreamLimits(MediaState state, const Source& source, int stream) {
    const Range<SafeRational> range = source.rationalTimeRangeForTrack(stream);
    state.minMediaStart = range.first();
    state.maxMediaEnd = range.first() + range.second();
    if (state.mediaDuration > SafeRational(0)) {
        state.minMediaStart = std::min(state.minMediaStart, state.mediaStart);
        state.maxMediaEnd = std::max(state.maxMediaEnd, state.mediaEnd());
    }
    return state;
}

void FileMedia::takeStreamLimits(Media& clip) const {
    const boost::shared_ptr<const Source> playing = source();
    if (!playing) return;
    const MediaState now = clip.state();
    const MediaState next = withStreamLimits(now, *playing, stream_);
    if (next != now) clip.restoreState(next, 0);
}

} // namespace VelaMediaLib
