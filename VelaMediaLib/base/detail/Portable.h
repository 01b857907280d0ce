#pragma once
// The few processor and compiler specifics the lock needs, each with a
// portable fallback: a pause between spins, the lowest set bit, a branch
// hint and the fast thread-local model.

#include <cstdint>

#if defined(_MSC_VER)
#include <intrin.h>
#endif

namespace VelaMediaLib {
namespace detail {

/// Tells the processor that this thread spins, so that its sibling runs.
inline void cpuRelax() {
#if defined(_MSC_VER) && (defined(_M_X64) || defined(_M_IX86))
    _mm_pause();
#elif defined(_MSC_VER) && defined(_M_ARM64)
    __yield();
#elif (defined(__GNUC__) || defined(__clang__)) && (defined(__x86_64__) || defined(__i386__))
    __builtin_ia32_pause();
#elif (defined(__GNUC__) || defined(__clang__)) && (defined(__aarch64__) || defined(__arm__))
    __asm__ __volatile__("yield");
#endif
}

/// The index of the lowest set bit; the value must not be 0.
inline int lowestSetBit(unsigned long long value) {
#if defined(__GNUC__) || defined(__clang__)
    return __builtin_ctzll(value);
#elif defined(_MSC_VER) && defined(_M_X64)
    unsigned long index;
    _BitScanForward64(&index, value);
    return int(index);
#else
    int index = 0;
    for (; !(value & 1ULL); value >>= 1) ++index;
    return index;
#endif
}

} // namespace detail
} // namespace VelaMediaLib

#if defined(__GNUC__) || defined(__clang__)
#define VELA_LIKELY(x) __builtin_expect(!!(x), 1)
/// Thread-locals of the library itself need no lazy set-up on each access.
#define VELA_TLS __attribute__((tls_model("initial-exec")))
#else
#define VELA_LIKELY(x) (x)
#define VELA_TLS
#endif

/// ThreadSanitizer neither takes standalone fences nor sees a process-wide
/// barrier: under it the lock fences each reader instead.
#if defined(__SANITIZE_THREAD__)
#define VELA_THREAD_SANITIZER 1
#elif defined(__has_feature)
#if __has_feature(thread_sanitizer)
#define VELA_THREAD_SANITIZER 1
#endif
#endif
#ifndef VELA_THREAD_SANITIZER
#define VELA_THREAD_SANITIZER 0
#endif
