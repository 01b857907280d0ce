#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/AbstractUnifiedMedia.h>

#include <atomic>
#include <boost/function.hpp>

namespace VelaMediaLib {

class Source;

/// The timing of a unified clip and of its two parts, as saved together.
/// Restoring the unified state alone gives the parts theirs back: they are
/// derived from it.
struct VELAMEDIALIB_API UnifiedMediaState {
    MediaState unified;
    MediaState visual;
    MediaState audio;

    bool operator==(const UnifiedMediaState& o) const {
        return unified == o.unified && visual == o.visual && audio == o.audio;
    }
    bool operator!=(const UnifiedMediaState& o) const { return !(*this == o); }
};

/// One visual clip and one audio clip of the same recording, standing on a
/// track as one clip with one timing state. The parts follow it: each
/// plays the unified clip's media range at its scalar over its whole
/// duration, from 0 in the unified clip's time (so a part's parametric time
/// is the unified clip's), within its own limits. The unified clip's limits
/// are those the two parts share, so a trim it allows both parts allow.
/// Its visual parameters are its visual part's and its volume its audio
/// part's (the same objects): what is set on the unified clip stays with the
/// parts when they are separated. Effects, attributes, metadata and
/// transitions are the unified clip's own.
class VELAMEDIALIB_API UnifiedMedia : public AbstractUnifiedMedia {
public:
    typedef boost::function<void(const boost::shared_ptr<VisualMedia>&, const boost::shared_ptr<AudioMedia>&)>
        InternalsVisitor;

    /// Binds the two clips, which must lie on no track. The unified clip
    /// stands where the visual clip stood and plays its slice; the audio clip
    /// is made to play the same slice. Refuses, in this order, a missing
    /// audio clip, a missing visual clip, an audio clip on a track and a
    /// visual clip on a track (with the system's messages), then one clip
    /// given as both parts, a clip inside another clip, and clips of two
    /// projects. A refusal changes neither clip.
    static boost::shared_ptr<UnifiedMedia> create(const boost::shared_ptr<VisualMedia>& visual,
                                                  const boost::shared_ptr<AudioMedia>& audio);

    const boost::shared_ptr<VisualMedia>& internalVisualMedia() const { return visual_; }
    const boost::shared_ptr<AudioMedia>& internalAudioMedia() const { return audio_; }
    /// Calls the visitor with the two parts.
    void accessInternals(const InternalsVisitor& visitor) const { visitor(visual_, audio_); }
    UnifiedMediaState unifiedMediaState() const;

    /// A deep copy whose file parts play the source's streams instead. Each
    /// file part checks the source as FileMedia::setSource does (another
    /// project, a missing stream or one of another kind is refused) before
    /// either changes; throws TypeException when no part plays a file and
    /// VelaMediaLibException for no source.
    boost::shared_ptr<UnifiedMedia> cloneWithSource(const boost::shared_ptr<const Source>& source) const;

    /// Lets go of the parts so that they can stand on tracks of their own
    /// (separating): the unified clip keeps them only to take them back.
    /// While let go, its edits do not reach them.
    void releaseInternals();
    /// Takes the parts back and brings them to its timing again; refuses, as
    /// create does, a part on a track or inside another clip.
    void adoptInternals();
    bool holdsInternals() const;

    boost::shared_ptr<Media> clone() const override;
    void dispatch(MediaDispatcher& dispatcher) override;
    void dispatch(ConstMediaDispatcher& dispatcher) const override;
    /// The parts take their sources' limits, then the unified clip the limits they share.
    void mediaSourceChanged() override;
    /// Also tells the parts when its timing moved them.
    void notify() override;
    /// Writes the parts as "video" and "audio".
    void toJSONSpecificProperties(XMLOptions& options, int indent) const override;

protected:
    /// Refuses a trim that is not valid with "invalid trim of unified media".
    MediaState stateAfter(const TimingEdit& edit) const override;
    /// Takes the state and brings the parts to it, under one write lock.
    bool takeStateUnnotified(const MediaState& next) override;
    boost::shared_ptr<ParameterInterface> createDefaultParameter(const std::string& name) const override;

private:
    UnifiedMedia(const boost::shared_ptr<VisualMedia>& visual, const boost::shared_ptr<AudioMedia>& audio,
                 const MediaState& initial);
    /// Brings the parts to the state, under the write lock the caller holds.
    void syncPartsLocked(const MediaState& unified);
    /// Makes this clip's visual parameters and volume its parts' objects.
    void shareForwardedParameters();

    const boost::shared_ptr<VisualMedia> visual_;
    const boost::shared_ptr<AudioMedia> audio_;
    MediaImpl* const visualImpl_;
    MediaImpl* const audioImpl_;
    bool holding_ = false;                 // under the project's lock
    std::atomic<bool> partsToTell_{false}; // parts moved since the last notify
};

} // namespace VelaMediaLib
