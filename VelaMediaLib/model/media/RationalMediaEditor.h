#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/rational/TimeExceptions.h>
#include <VelaMediaLib/model/media/MediaState.h>
#include <VelaMediaLib/base/VelaObject.h>

namespace VelaMediaLib {

class MediaImpl;

/// The arithmetic of a clip's timing. An editor computes the state a clip
/// would have after an edit, or throws; the clip takes the new state only
/// when the editor returned one, so a refused edit changes nothing.
class VELAMEDIALIB_API RationalMediaEditor : public VelaObject {
public:
    explicit RationalMediaEditor(const MediaImpl& clip) : clip_(clip) {}

    virtual MediaState move(const MediaState& state, VelaTime offset) const;
    /// Throws InvalidTrimRangeException "invalid media start trim offset".
    virtual MediaState trimStart(const MediaState& state, VelaTime offset) const = 0;
    virtual bool validTrimStart(const MediaState& state, VelaTime offset) const = 0;
    /// Throws InvalidTrimRangeException "invalid media trim end offset".
    virtual MediaState trimEnd(const MediaState& state, VelaTime offset) const = 0;
    virtual bool validTrimEnd(const MediaState& state, VelaTime offset) const = 0;
    /// The same for every editor: the scalar times the factor, the media
    /// range and the start kept, and the duration the media duration times the
    /// new scalar to the nearest tick (not the old, already rounded duration
    /// scaled, which would drift). Throws ValueException<double>
    /// "invalid duration after media stretch (<=0)", and "a stretch must
    /// leave the clip room for its transitions" below minimumTrackDuration.
    virtual MediaState stretch(const MediaState& state, const SafeRational& factor) const;
    virtual VelaTime trimEndLimit(const MediaState& state) const = 0;
    virtual VelaTime trimStartLimit(const MediaState& state) const = 0;
    /// Checks a saved state against its own limits; throws
    /// ValueException<const SafeRational> naming the first inconsistency.
    /// Refuses, as construction does, a duration, media duration or scalar
    /// that is not above 0.
    virtual MediaState restoreState(const MediaState& saved, VelaTime tolerance) const;

    /// The shortest track duration the clip's transitions allow: the sum of
    /// both lengths less one tick, never negative.
    VelaTime minimumTrackDuration() const;
    /// The track duration the table defines: media duration times scalar,
    /// rounded to the nearest tick.
    static VelaTime durationFor(const SafeRational& mediaDuration, const SafeRational& scalar);
    /// x, or b when x lies within 1/10000 of it.
    static SafeRational snap(const SafeRational& x, const SafeRational& b);

protected:
    const MediaImpl& clip_;
};

} // namespace VelaMediaLib
