#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/commands/edits/AtomicEditCmd.h>
#include <VelaMediaLib/commands/edits/MagneticEffects.h>

namespace VelaMediaLib {

/// What the two trims share: the effects that follow the trimmed edge move
/// with it (their other edge stays put on the time line), and everything
/// else the clip holds in its own ticks (keyframes, animations, the other
/// effects) stays with the content it was on: a start trim shifts them by
/// the start's move. Undo gives back the clip's exact state, content and
/// effect list, and redo the exact ones the trim gave. Two trims of the same edge of the same clip in a row
/// combine into one undo step: undone to the first one's state, redone to the second one's, with the sum as
/// its delta.
class VELAMEDIALIB_API EdgeTrimCmd : public AtomicEditCmd {
public:
    const EdgeEffects& edgeEffects() const { return edgeEffects_; }
    bool execute(CommandHandler* handler) override;
    bool unexecute(CommandHandler* handler) override;
    bool reexecute(CommandHandler* handler) override;
    CommandPtr combine(const CommandPtr& later) override;

protected:
    EdgeTrimCmd(const TrackPtr& track, const MediaPtr& media, VelaTime delta, const EdgeEffects& effects,
                bool startEdge)
        : AtomicEditCmd(track, media, delta), edgeEffects_(effects), startEdge_(startEdge) {}
    /// A trim of the same edge, to hold two combined.
    virtual boost::shared_ptr<EdgeTrimCmd> sameEdge(VelaTime delta) const = 0;

private:
    /// How far the clip's own ticks moved back (0 for an end trim).
    VelaTime originShift() const;
    /// Shifts keyframes and animations and gives the clip the effect list.
    void applyContent(const Effectable::Effects& effects, VelaTime shift);

    EdgeEffects edgeEffects_;
    bool startEdge_;
    Effectable::Effects savedEffects_;
    Effectable::Effects afterEffects_;
};

/// Moves a clip's start edge by a tick delta (positive shortens it), the
/// content under the rest staying in place.
class VELAMEDIALIB_API TrimStartCmd : public EdgeTrimCmd {
public:
    /// The effects that follow the edge are usually magneticEffectsForMedia(media).
    static boost::shared_ptr<TrimStartCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                  VelaTime delta, const EdgeEffects& effects);
    /// With the clip's magnetized effects following the edge.
    static boost::shared_ptr<TrimStartCmd> create(const TrackPtr& track, const MediaPtr& media,
                                                  VelaTime delta);

private:
    TrimStartCmd(const TrackPtr& track, const MediaPtr& media, VelaTime delta, const EdgeEffects& effects)
        : EdgeTrimCmd(track, media, delta, effects, true) {}
    boost::shared_ptr<EdgeTrimCmd> sameEdge(VelaTime delta) const override;
};

/// Moves a clip's end edge in by a tick delta (positive shortens it, negative
/// plays more media).
class VELAMEDIALIB_API TrimEndCmd : public EdgeTrimCmd {
public:
    static boost::shared_ptr<TrimEndCmd> create(const TrackPtr& track, const MediaPtr& media, VelaTime delta,
                                                const EdgeEffects& effects);
    static boost::shared_ptr<TrimEndCmd> create(const TrackPtr& track, const MediaPtr& media, VelaTime delta);

private:
    TrimEndCmd(const TrackPtr& track, const MediaPtr& media, VelaTime delta, const EdgeEffects& effects)
        : EdgeTrimCmd(track, media, delta, effects, false) {}
    boost::shared_ptr<EdgeTrimCmd> sameEdge(VelaTime delta) const override;
};

} // namespace VelaMediaLib
