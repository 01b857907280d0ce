#pragma once

#include <VelaMediaLib/base/Export.h>
#include <VelaMediaLib/model/timeline/Mixer.h>

#include <algorithm>

namespace VelaMediaLib {

/// The project's clipboard: clippings, each a copied portion of tracks.
class VELAMEDIALIB_API ClipBoard : public VelaObject, public ProjectToken {
public:
    explicit ClipBoard(const boost::weak_ptr<const ThreadSafe>& token) : ProjectToken(token) {}

    void addClipping(const MixerPtr& clipping) {
        ScopedWriteLock lock(projectMutex());
        clippings_.push_back(clipping);
    }
    /// Returns whether the clipboard held it.
    bool removeClipping(const MixerPtr& clipping) {
        ScopedWriteLock lock(projectMutex());
        const auto found = std::find(clippings_.begin(), clippings_.end(), clipping);
        if (found == clippings_.end()) return false;
        clippings_.erase(found);
        return true;
    }
    std::vector<MixerPtr> clippings() const {
        ScopedReadLock lock(projectLock());
        return clippings_;
    }

private:
    std::vector<MixerPtr> clippings_;
};

} // namespace VelaMediaLib
