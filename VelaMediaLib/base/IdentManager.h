#pragma once

#include <VelaMediaLib/base/Export.h>

#include <cstdint>
#include <mutex>
#include <vector>

namespace VelaMediaLib {

/// Hands out the identifiers of objects that documents refer to: a counter
/// from 0, with retired identifiers reused last in, first out. The process
/// has one, made on first use; it takes a small lock of its own so that
/// clips may be made on several threads.
class VELAMEDIALIB_API IdentManager {
public:
    IdentManager() = default;
    static IdentManager& instance();

    uint32_t newIdent();
    void retireIdent(uint32_t ident);

private:
    std::mutex mutex_;
    uint32_t counter_ = 0;
    std::vector<uint32_t> retired_;
};

} // namespace VelaMediaLib
