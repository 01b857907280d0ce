#include <VelaMediaLib/time/ThreadSafe.h>

#include <VelaMediaLib/time/NotifyDelay.h>

namespace VelaMediaLib {

ThreadSafe::~ThreadSafe() { NotifyDelay::removeMappingForThreadSafe(this); }

} // namespace VelaMediaLib
