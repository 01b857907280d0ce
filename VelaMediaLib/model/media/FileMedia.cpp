#include <VelaMediaLib/model/media/FileMedia.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/model/source/MediaFileStats.h>
#include <VelaMediaLib/model/source/Source.h>
#include <VelaMediaLib/time/rational/RationalUtil.h>

#include <algorithm>
#include <cstdlib>

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

FileMedia::FileMedia(const SourceLink& link, StreamFilter plays)
    : strong_(link.strong), weak_(link.weak), stream_(link.stream), plays_(plays), token_(tokenOf(link)) {
    if (link.source()) checkStream(link, plays);
}

boost::shared_ptr<const Source> FileMedia::source() const {
    if (const auto held = boost::atomic_load(&strong_)) return held;
    return weak_.lock();
}

void FileMedia::checkSource(const boost::shared_ptr<const Source>& source) const {
    if (!source) return;
    if (token_.empty()) throw AddRemoveException("a file clip made without a source cannot take one");
    const boost::weak_ptr<const ThreadSafe> theirs = source->projectMutex();
    if (token_.owner_before(theirs) || theirs.owner_before(token_))
        throw AddRemoveException("the source belongs to another project");
    checkStream(SourceLink::holding(source, stream_), plays_);
}

void FileMedia::setSource(const boost::shared_ptr<const Source>& source) {
    checkSource(source);
    boost::atomic_store(&strong_, source);
}

namespace {

/// The link's source, checked to have the stream, of a kind the clip plays.
boost::shared_ptr<const Source> checkedSource(const SourceLink& link, StreamFilter plays) {
    const boost::shared_ptr<const Source> source = link.source();
    if (!source) throw VelaMediaLibException("a file clip needs a source");
    const boost::shared_ptr<MediaFileStats> stats = source->stats();
    const TrackType type = stats->trackType(link.stream); // checks the index
    if (!plays(type))
        throw TypeException("stream " + std::to_string(link.stream) + " of " + stats->filename() +
                            " is not of a kind this clip plays");
    return source;
}

/// A slice within the limits of a stream of the given range.
MediaState sliceOf(const Range<SafeRational>& range, VelaTime start, const SafeRational& mediaStart,
                   const SafeRational& mediaDuration, const SafeRational& scalar) {
    MediaState state;
    state.minMediaStart = range.first();
    state.maxMediaEnd = range.first() + range.second();
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
    const boost::shared_ptr<const Source> source = checkedSource(link, plays);
    return sliceOf(source->rationalTimeRangeForTrack(link.stream), start, mediaStart, mediaDuration, scalar);
}

MediaState FileMedia::wholeStreamState(const SourceLink& link, StreamFilter plays, VelaTime start) {
    return wholeRangeState(checkedSource(link, plays)->rationalTimeRangeForTrack(link.stream), start);
}

MediaState FileMedia::wholeRangeState(const Range<SafeRational>& range, VelaTime start) {
    const SafeRational length = range.second();
    const SafeRational ticks = std::max(RationalUtil::Round(length), SafeRational(1));
    return sliceOf(range, start, range.first(), length, length > SafeRational(0) ? ticks / length : ticks);
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

MediaState FileMedia::withOwnStreamLimits(const MediaState& state) const {
    const boost::shared_ptr<const Source> playing = source();
    return playing ? withStreamLimits(state, *playing, stream_) : state;
}

void FileMedia::takeStreamLimits(Media& clip) const {
    const MediaState now = clip.state();
    const MediaState next = withOwnStreamLimits(now);
    if (next == now) return;
    // Only the limits change, widened around the slice: the restore checks
    // pass, allowing the clip the rounding it already has.
    const VelaTime rounding = std::abs(
        RationalUtil::toVelaTime(RationalUtil::Round(now.mediaDuration * now.scalar)) - now.duration);
    clip.restoreState(next, rounding);
}

} // namespace VelaMediaLib
