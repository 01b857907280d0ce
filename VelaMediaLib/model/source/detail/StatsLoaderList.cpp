#include <VelaMediaLib/model/source/detail/StatsLoaderList.h>

#include <VelaMediaLib/base/VelaMediaLibException.h>

#include <algorithm>

namespace VelaMediaLib {
namespace detail {

StatsLoaderList::StatsLoaderList() : loaders_(std::make_shared<const Loaders>()) {}

StatsLoaderList& StatsLoaderList::instance() {
    static StatsLoaderList list;
    return list;
}

void StatsLoaderList::add(const boost::shared_ptr<StatsLoader>& loader, int priority) {
    if (!loader) throw VelaMediaLibException("no stats loader given");
    std::lock_guard<std::mutex> lock(mutex_);
    auto next = std::make_shared<Loaders>(*loaders_);
    const auto present = std::find(next->begin(), next->end(), loader);
    if (present != next->end()) {
        next->erase(present);
    } else if (next->size() >= next->max_size()) {
        throw VelaMediaLibException("list too long");
    }
    next->insert(priority != 0 ? next->begin() : next->end(), loader);
    loaders_ = std::move(next);
}

bool StatsLoaderList::remove(const boost::shared_ptr<StatsLoader>& loader) {
    std::lock_guard<std::mutex> lock(mutex_);
    const auto present = std::find(loaders_->begin(), loaders_->end(), loader);
    if (present == loaders_->end()) return false;
    auto next = std::make_shared<Loaders>(*loaders_);
    next->erase(next->begin() + (present - loaders_->begin()));
    loaders_ = std::move(next);
    return true;
}

std::shared_ptr<const StatsLoaderList::Loaders> StatsLoaderList::snapshot() const {
    std::lock_guard<std::mutex> lock(mutex_);
    return loaders_;
}

} // namespace detail
} // namespace VelaMediaLib
