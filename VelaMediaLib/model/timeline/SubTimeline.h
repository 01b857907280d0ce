#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/effects/Effectable.h>
#include <VelaMediaLib/time/parameters/Attributable.h>
#include <VelaMediaLib/base/Identified.h>
#include <VelaMediaLib/time/parameters/Parametric.h>
#include <VelaMediaLib/model/project/SubProject.h>
#include <VelaMediaLib/model/media/Temporal.h>
#include <VelaMediaLib/time/sync/Observable.h>

namespace VelaMediaLib {

/// What clips, tracks and mixers have in common: they are parts of a project
/// that can be observed, carry parameters, effects and attributes, stand in
/// time and have a name.
class VELAMEDIALIB_API SubTimeline : public SubProject,
                                     public virtual Observable,
                                     public Parametric,
                                     public Effectable,
                                     public Attributable,
                                     public Temporal,
                                     public Identified {
public:
    explicit SubTimeline(const boost::weak_ptr<const ThreadSafe>& token)
        : SubProject(token), Parametric(token), Attributable(token) {}
};

} // namespace VelaMediaLib
