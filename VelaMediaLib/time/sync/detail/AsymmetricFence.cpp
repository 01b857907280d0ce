#include <VelaMediaLib/time/sync/detail/AsymmetricFence.h>

#include <VelaMediaLib/base/detail/Portable.h>

#include <cstdio>
#include <cstdlib>
#include <mutex>

#if defined(__linux__) && defined(__has_include)
#if __has_include(<linux/membarrier.h>)
#include <linux/membarrier.h> // its commands are enumerators, not macros
#include <sys/mman.h>
#include <sys/syscall.h>
#include <unistd.h>
#define VELA_HAVE_MEMBARRIER 1
#endif
#elif defined(_WIN32)
#include <windows.h>
#endif

namespace VelaMediaLib {
namespace detail {

// ThreadSanitizer sees no process-wide barrier, and a build may opt out.
#if VELA_THREAD_SANITIZER || defined(VELA_NO_ASYMMETRIC_FENCE)
#define VELA_BARRIER_WANTED 0
#else
#define VELA_BARRIER_WANTED 1
#endif

#if VELA_BARRIER_WANTED && defined(VELA_HAVE_MEMBARRIER) && defined(__NR_membarrier)

namespace {

long membarrier(int command) { return syscall(__NR_membarrier, command, 0, 0); }

bool registerExpedited() { return membarrier(MEMBARRIER_CMD_REGISTER_PRIVATE_EXPEDITED) == 0; }

// Changing a page's protection makes the kernel shoot its translation down on
// every processor running the process, by interrupt, which fences each of
// them: on x86 a barrier for a process that a sandbox no longer lets make the
// membarrier call. Best effort: a processor that drops translations by a
// broadcast instruction rather than an interrupt would not fence; sandboxed
// hosts should build without the barrier instead. One writer at a time (another's read-only step between
// this one's two steps would fault its write), and the page locked in (a page
// swapped out might change without a shoot-down).
bool protectionChangeFence() {
#if defined(__x86_64__) || defined(__i386__)
    static std::mutex serial;
    static void* const page = mmap(nullptr, size_t(sysconf(_SC_PAGESIZE)), PROT_READ | PROT_WRITE,
                                   MAP_PRIVATE | MAP_ANONYMOUS, -1, 0);
    if (page == MAP_FAILED) return false;
    const size_t size = size_t(sysconf(_SC_PAGESIZE));
    std::lock_guard<std::mutex> lock(serial);
    if (mlock(page, size) != 0) return false; // a page that may be swapped out proves nothing
    if (mprotect(page, size, PROT_READ | PROT_WRITE) != 0) return false;
    *static_cast<volatile char*>(page) = 1; // the page must be mapped for the change to reach others
    return mprotect(page, size, PROT_READ) == 0;
#else
    return false; // elsewhere processors may drop translations without interrupting each other
#endif
}

} // namespace

bool asymmetricFenceAvailable() {
    static const bool available = registerExpedited() && membarrier(MEMBARRIER_CMD_PRIVATE_EXPEDITED) == 0;
    return available;
}

// The expedited barrier fails only if the registration got lost (registering
// again mends that) or a sandbox installed since refuses the call: then the
// slow global barrier comes next, and a protection change, which fences on
// x86 only, is the last resort. Readers rely on the fence: with none left,
// going on could let a writer run beside them.
void heavyFence() {
    if (membarrier(MEMBARRIER_CMD_PRIVATE_EXPEDITED) == 0) return;
    if (registerExpedited() && membarrier(MEMBARRIER_CMD_PRIVATE_EXPEDITED) == 0) return;
    if (membarrier(MEMBARRIER_CMD_GLOBAL) == 0 || protectionChangeFence()) return;
    std::fputs("VelaMediaLib: no process-wide memory barrier is left (membarrier refused); "
               "build with VELA_ASYMMETRIC_FENCE=OFF for sandboxes that refuse it\n",
               stderr);
    std::abort();
}

#elif VELA_BARRIER_WANTED && defined(_WIN32)

bool asymmetricFenceAvailable() { return true; }
void heavyFence() { FlushProcessWriteBuffers(); }

#else

bool asymmetricFenceAvailable() { return false; }
void heavyFence() {}

#endif

} // namespace detail
} // namespace VelaMediaLib
