#pragma once
// Counts the bytes that global operator new hands out, for memory figures.
// Include it in exactly one file of a benchmark program.

#include <atomic>
#include <cstdlib>
#include <new>

namespace AllocationCounter {
inline std::atomic<long long>& bytes() {
    static std::atomic<long long> total{0};
    return total;
}
} // namespace AllocationCounter

void* operator new(std::size_t size) {
    AllocationCounter::bytes() += (long long)size;
    if (void* memory = std::malloc(size ? size : 1)) return memory;
    throw std::bad_alloc();
}
// GCC takes free() of what this operator new returned for a mismatch, though
// both sides are this file's own.
#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wmismatched-new-delete"
#endif
void operator delete(void* memory) noexcept { std::free(memory); }
void operator delete(void* memory, std::size_t) noexcept { std::free(memory); }
#if defined(__GNUC__) && !defined(__clang__)
#pragma GCC diagnostic pop
#endif
