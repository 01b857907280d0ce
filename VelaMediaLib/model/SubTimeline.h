#pragma once

#include <VelaMediaLib/effects/Effectable.h>
#include <VelaMediaLib/model/Attributable.h>
#include <VelaMediaLib/model/Identified.h>
#include <VelaMediaLib/model/Parametric.h>
#include <VelaMediaLib/model/SubProject.h>
#include <VelaMediaLib/model/Temporal.h>
#include <VelaMediaLib/time/Observable.h>

namespace VelaMediaLib {

/// What clips, tracks and mixers have in common: they are parts of a project
/// that can be observed, carry parameters, effects and attributes, stand in
/// time and have a name.
class SubTimeline : public SubProject,
                    public Observable,
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
