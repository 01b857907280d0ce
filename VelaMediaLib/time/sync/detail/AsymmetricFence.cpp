#include <VelaMediaLib/time/sync/detail/AsymmetricFence.h>

#include <VelaMediaLib/base/detail/Portable.h>

#include <cstdio>
#include <cstdlib>

#if defined(__linux__)
#include <linux/membarrier.h>
#include <sys/syscall.h>
#include <unistd.h>
#elif defined(_WIN32)
#include <windows.h>
#endif

namespace VelaMediaLib {
namespace detail {

#if VELA_THREAD_SANITIZER

bool asymmetricFenceAvailable() { return false; }
void heavyFence() {}

#elif defined(__linux__) && defined(__NR_membarrier)

namespace {

long membarrier(int command) { return syscall(__NR_membarrier, command, 0, 0); }

bool registerExpedited() { return membarrier(MEMBARRIER_CMD_REGISTER_PRIVATE_EXPEDITED) == 0; }

} // namespace

bool asymmetricFenceAvailable() {
    static const bool available = registerExpedited() && membarrier(MEMBARRIER_CMD_PRIVATE_EXPEDITED) == 0;
    return available;
}

// The expedited barrier fails only if the registration got lost; registering
// again mends that, and the slow global barrier is the last resort.
void heavyFence() {
    if (membarrier(MEMBARRIER_CMD_PRIVATE_EXPEDITED) == 0) return;
    if (registerExpedited() && membarrier(MEMBARRIER_CMD_PRIVATE_EXPEDITED) == 0) return;
    if (membarrier(MEMBARRIER_CMD_GLOBAL) == 0) return;
    std::fputs("VelaMediaLib: the process-wide memory barrier stopped working\n", stderr);
    std::abort(); // readers rely on it: going on could let a writer run beside them
}

#elif defined(_WIN32)

bool asymmetricFenceAvailable() { return true; }
void heavyFence() { FlushProcessWriteBuffers(); }

#else

bool asymmetricFenceAvailable() { return false; }
void heavyFence() { std::atomic_thread_fence(std::memory_order_seq_cst); }

#endif

} // namespace detail
} // namespace VelaMediaLib
