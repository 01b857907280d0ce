#pragma once
// A fence split unevenly between many cheap sides and one dear side. The
// cheap side (a reader taking the lock) only stops the compiler from
// reordering; the dear side (a writer taking the lock) makes every other
// running thread of the process pass a full memory fence before it goes on.
// Together they order the reader's store before its load just as a full
// fence on each side would, while readers never stall on their own pending
// stores.

#include <VelaMediaLib/base/Export.h>

#include <atomic>

namespace VelaMediaLib {
namespace detail {

/// Whether the dear side is available on this system. Asked once; when it is
/// false, both sides must use full fences.
VELAMEDIALIB_API bool asymmetricFenceAvailable();

/// The cheap side: orders nothing in hardware on its own.
inline void lightFence() { std::atomic_signal_fence(std::memory_order_seq_cst); }

/// The dear side: returns once every thread of the process that runs at the
/// moment has passed a full fence. Only to be called when
/// asymmetricFenceAvailable() answered true.
VELAMEDIALIB_API void heavyFence();

} // namespace detail
} // namespace VelaMediaLib
