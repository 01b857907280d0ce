#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/time/sync/Subject.h>

namespace VelaMediaLib {

/// A subject attached to and detached from on several threads whose
/// observers must know when they are done (the command history, the edit
/// rate). Every subject now guards its lists alike (see ObserverList): once
/// detach has returned on a thread that holds no project lock, the observer is
/// not running and will not be called; the name stays for these subjects.
class VELAMEDIALIB_API SubjectWithMutex : public Subject {
public:
    using Subject::Subject;
};

} // namespace VelaMediaLib
