#include <VelaMediaLib/base/IdentManager.h>

namespace VelaMediaLib {

IdentManager& IdentManager::instance() {
    static IdentManager* manager = new IdentManager; // outlives objects destroyed at exit
    return *manager;
}

uint32_t IdentManager::newIdent() {
    std::lock_guard<std::mutex> lock(mutex_);
    if (retired_.empty()) return counter_++;
    const uint32_t ident = retired_.back();
    retired_.pop_back();
    return ident;
}

void IdentManager::retireIdent(uint32_t ident) {
    std::lock_guard<std::mutex> lock(mutex_);
    retired_.push_back(ident);
}

} // namespace VelaMediaLib
