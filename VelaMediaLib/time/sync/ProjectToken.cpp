#include <VelaMediaLib/time/sync/ProjectToken.h>

#include <VelaMediaLib/time/sync/ThreadSafe.h>

namespace VelaMediaLib {

boost::shared_ptr<ReadWriteMutex> ProjectToken::lockOf(const boost::weak_ptr<const ThreadSafe>& token) {
    const boost::shared_ptr<const ThreadSafe> project = token.lock();
    return project ? project->sharedMutex() : boost::shared_ptr<ReadWriteMutex>();
}

} // namespace VelaMediaLib
