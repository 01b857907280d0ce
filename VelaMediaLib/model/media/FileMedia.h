#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/MediaState.h>
#include <VelaMediaLib/model/project/Sourceable.h>
#include <VelaMediaLib/model/source/TrackType.h>

#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

class Media;
class ProjectEditRate;
class Source;
class ThreadSafe;

/// How a file clip holds its source. A clip placed by a host holds it
/// strongly (a clip keeps its source alive); the clips a source keeps of its
/// own streams hold it weakly, so that the two do not keep each other alive.
struct VELAMEDIALIB_API SourceLink {
    boost::shared_ptr<const Source> strong;
    boost::weak_ptr<const Source> weak;
    int stream = 0;

    static SourceLink holding(const boost::shared_ptr<const Source>& source, int stream);
    static SourceLink ownedBy(const boost::shared_ptr<const Source>& source, int stream);
    boost::shared_ptr<const Source> source() const { return strong ? strong : weak.lock(); }
};

/// Which stream kinds a clip kind plays.
typedef bool (*StreamFilter)(TrackType type);

/// What the file kinds share: the stream of a source they play, and the
/// timing that the stream's range gives them.
class VELAMEDIALIB_API FileMedia : public Sourceable {
public:
    /// The stream of the source the clip plays.
    int streamIndex() const { return stream_; }
    boost::shared_ptr<const Source> source() const override;
    /// Safe against readers on other threads; the caller then tells the
    /// clip (mediaSourceChanged) so that it takes the new stream's limits.
    /// Refuses, as checkSource does, a source the clip cannot play.
    void setSource(const boost::shared_ptr<const Source>& source) override;
    /// Throws unless the source is of the clip's project (AddRemoveException)
    /// and has the clip's stream, of a kind the clip plays (the exceptions of
    /// checkStream); null passes.
    void checkSource(const boost::shared_ptr<const Source>& source) const override;
    /// Whether the clip is one of its source's own.
    bool isSourcesOwnMedia() const { return !weak_.expired() && !boost::atomic_load(&strong_); }

    /// The state of a clip that plays the slice from mediaStart for
    /// mediaDuration (ticks of the source's edit rate) at the scalar, from
    /// start on its track, within the stream's limits. Throws
    /// VelaMediaLibException for no source, IndexException "stream index out
    /// of range", TypeException when the clip kind does not play the stream,
    /// and ValueException<const SafeRational> "media range outside the
    /// stream" or "invalid duration after media stretch (<=0)".
    static MediaState stateFor(const SourceLink& link, StreamFilter plays, VelaTime start,
                               const SafeRational& mediaStart, const SafeRational& mediaDuration,
                               const SafeRational& scalar);
    /// Checks that the link leads to a source whose stream the clip kind plays
    /// (the exceptions of stateFor).
    static void checkStream(const SourceLink& link, StreamFilter plays);
    /// The state of a clip that plays the whole stream at normal speed.
    static MediaState wholeStreamState(const SourceLink& link, StreamFilter plays, VelaTime start);
    /// The same for a stream of the given range (ticks of the edit rate):
    /// its rounded length at scalar 1, or one tick at a slower scalar for a
    /// stream shorter than half a tick. Throws as stateFor for no length.
    static MediaState wholeRangeState(const Range<SafeRational>& range, VelaTime start);
    /// A state with the limits of the stream, widened where the clip plays
    /// beyond them (a shorter file taking a source's place loses no clip).
    static MediaState withStreamLimits(MediaState state, const Source& source, int stream);

    /// The project token and edit rate of the link's source, for a clip's bases.
    static boost::weak_ptr<const ThreadSafe> tokenOf(const SourceLink& link);
    static boost::weak_ptr<ProjectEditRate> rateOf(const SourceLink& link);

protected:
    /// A clip of the kind playing the whole stream, or a slice of it (the
    /// kinds' create functions).
    template <typename Kind>
    static boost::shared_ptr<Kind> createWhole(const boost::shared_ptr<const Source>& source, int stream,
                                               VelaTime start) {
        const SourceLink link = SourceLink::holding(source, stream);
        return Kind::create(link, wholeStreamState(link, Kind::playsStream, start));
    }
    template <typename Kind>
    static boost::shared_ptr<Kind> createSlice(const boost::shared_ptr<const Source>& source, int stream,
                                               VelaTime start, const SafeRational& mediaStart,
                                               const SafeRational& mediaDuration,
                                               const SafeRational& scalar) {
        const SourceLink link = SourceLink::holding(source, stream);
        return Kind::create(link,
                            stateFor(link, Kind::playsStream, start, mediaStart, mediaDuration, scalar));
    }
    /// Gives the clip the limits of its source's stream (after a change of
    /// source, file or rate); the clip's slice, speed and place stay.
    void takeStreamLimits(Media& clip) const;
    /// The state with the limits of the source's stream as it is now.
    MediaState withOwnStreamLimits(const MediaState& state) const;
    /// Checks the link (checkStream) when it leads to a source.
    FileMedia(const SourceLink& link, StreamFilter plays);
    /// A link like this clip's, holding the source strongly (for clones).
    SourceLink cloneLink() const { return SourceLink::holding(source(), stream_); }

private:
    boost::shared_ptr<const Source> strong_; // read and written atomically
    const boost::weak_ptr<const Source> weak_;
    const int stream_;
    const StreamFilter plays_;
    const boost::weak_ptr<const ThreadSafe> token_; // the clip's project
};

} // namespace VelaMediaLib
