#include <VelaMediaLib/time/sync/ThreadSafe.h>

namespace VelaMediaLib {

// Plain new: the lock's reader slots are over-aligned.
ThreadSafe::ThreadSafe() : mutex_(new ReadWriteMutex()) {}

// The delay state goes with the project; subjects still held back are not
// touched, since they may be going away on other threads at the same time.
ThreadSafe::~ThreadSafe() = default;

} // namespace VelaMediaLib
