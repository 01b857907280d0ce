#pragma once

#include <boost/shared_ptr.hpp>
#include <memory>
#include <mutex>
#include <vector>

namespace VelaMediaLib {

class StatsLoader;

namespace detail {

/// The process-wide list of stats loaders. The list is an immutable snapshot
/// replaced whole under a mutex: a load takes the snapshot and asks its
/// loaders with no lock held, so changing the list never waits for a load,
/// and a load never sees a list half changed.
class StatsLoaderList {
public:
    typedef std::vector<boost::shared_ptr<StatsLoader>> Loaders;

    static StatsLoaderList& instance();

    /// Non-zero priority: first; 0: last. A loader present moves.
    void add(const boost::shared_ptr<StatsLoader>& loader, int priority);
    bool remove(const boost::shared_ptr<StatsLoader>& loader);
    std::shared_ptr<const Loaders> snapshot() const;

private:
    StatsLoaderList();

    mutable std::mutex mutex_;
    std::shared_ptr<const Loaders> loaders_;
};

} // namespace detail
} // namespace VelaMediaLib
