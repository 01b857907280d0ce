#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/media/Media.h>
#include <VelaMediaLib/time/parameters/ParameterInterface.h>

#include <boost/rational.hpp>
#include <vector>

namespace VelaMediaLib {

/// How times held in ticks follow a change of edit rate: the factor is the
/// new rate over the old one. Exact values (media ranges, limits, keyframe
/// times and lead-ins) are multiplied by it exactly. Whole ticks (a clip's
/// start and duration, transition, edge and effect lengths, animation ranges,
/// hotspot times) go to the nearest tick, halves away from zero: a change to
/// a finer rate and back therefore finds every tick again, since the way back
/// divides each rounding error by the same factor and it stays below half a
/// tick. A clip's duration is never rounded on its own: it follows its exact
/// media duration (the duration rule) or, for a clip without media extent,
/// its old duration. The undo of a scaling gives back saved states, never a
/// scaling back.
class VELAMEDIALIB_API EditRateScale {
public:
    /// Throws ValueException<double> "an edit rate factor must be above zero".
    explicit EditRateScale(const SafeRational& factor);
    /// The factor from one rate to another. Throws ValueException<double>
    /// "an edit rate must be greater than 0" for a zero rate.
    static EditRateScale between(const boost::rational<unsigned long>& from,
                                 const boost::rational<unsigned long>& to);

    const SafeRational& factor() const { return factor_; }
    bool isIdentity() const { return factor_ == SafeRational(1); }
    /// The nearest tick, halves away from zero.
    VelaTime tick(VelaTime time) const;
    SafeRational exact(const SafeRational& value) const { return value * factor_; }

    /// The clip's state at the new rate, placed at start. A clip with media
    /// extent keeps its scalar, takes its media range and limits times the
    /// factor and lasts round(media duration x scalar); one without keeps its
    /// scalar and lasts its old duration scaled, its media following. Throws
    /// ValueException<double> "a clip would last no tick at the new edit rate".
    MediaState clipState(const Media& media, const MediaState& state, VelaTime start) const;
    /// The states of a track's clips (in start order) at the new rate. Clips
    /// that touched still touch (so transitions stay joined); others go to the
    /// nearest tick of their start, pushed on only where a rounded neighbour
    /// would overlap them.
    std::vector<MediaState> trackStates(const std::vector<MediaPtr>& clips) const;
    /// Multiplies the parameter's keyframe times and lead-ins by the factor,
    /// in an order in which no step meets another keyframe or lead-in.
    void scaleKeyframes(ParameterInterface& parameter) const;

private:
    SafeRational factor_;
};

} // namespace VelaMediaLib
