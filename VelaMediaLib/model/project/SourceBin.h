#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/base/VelaObject.h>
#include <VelaMediaLib/time/sync/ProjectToken.h>
#include <VelaMediaLib/time/sync/ThreadSafe.h>

#include <boost/shared_ptr.hpp>
#include <vector>

namespace VelaMediaLib {

class Source;

/// The project's imported sources, in the order they came.
class VELAMEDIALIB_API SourceBin : public VelaObject, public ProjectToken {
public:
    explicit SourceBin(const boost::weak_ptr<const ThreadSafe>& token) : ProjectToken(token) {}

    std::vector<boost::shared_ptr<Source>> sources() const {
        ScopedReadLock lock(projectLock());
        return sources_;
    }
    size_t size() const {
        ScopedReadLock lock(projectLock());
        return sources_.size();
    }

private:
    std::vector<boost::shared_ptr<Source>> sources_;
};

} // namespace VelaMediaLib
