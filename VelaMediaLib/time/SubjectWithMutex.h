#pragma once

#include <VelaMediaLib/time/Subject.h>

namespace VelaMediaLib {

/// A subject attached to and detached from on several threads (the command
/// history, the edit rate). Every subject now guards its lists alike, so this
/// is a plain subject under the name its users know.
class SubjectWithMutex : public Subject {
public:
    using Subject::Subject;
};

} // namespace VelaMediaLib
