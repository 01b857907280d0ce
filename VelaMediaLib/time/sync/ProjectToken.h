#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/shared_ptr.hpp>
#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

class ReadWriteMutex;
class ThreadSafe;

/// The weak token of the project an object belongs to, kept once per object:
/// every part that locks or notifies through the project (its subject, its
/// metadata, parameters and attributes) derives from this class as a virtual
/// base and asks it through projectMutex().
///
/// All parts of one object are given the same token. A part constructed with
/// a token records it; one constructed without leaves the token the other
/// parts recorded, so the order in which the parts are built does not matter.
class VELAMEDIALIB_API ProjectToken {
public:
    /// The project's token; empty for an object of no project, expired once
    /// the project has gone.
    const boost::weak_ptr<const ThreadSafe>& projectMutex() const { return token_; }
    /// The project's lock, which every object of the project holds a share
    /// of: a query locks it without touching the project's reference count,
    /// a line every reader thread would otherwise write. It outlives the
    /// project while objects of it remain; null for an object of no project.
    ReadWriteMutex* projectLock() const { return lock_.get(); }
    /// The share of the lock of the project a token leads to; null when it leads nowhere.
    static boost::shared_ptr<ReadWriteMutex> lockOf(const boost::weak_ptr<const ThreadSafe>& token);

protected:
    ProjectToken() = default;
    explicit ProjectToken(const boost::weak_ptr<const ThreadSafe>& token)
        : token_(token), lock_(lockOf(token)) {}
    ProjectToken(const ProjectToken&) = default;
    ProjectToken& operator=(const ProjectToken&) = default;
    ~ProjectToken() = default;

    /// Records the token a part was constructed with, unless it is empty.
    void recordProjectToken(const boost::weak_ptr<const ThreadSafe>& token) {
        if (!token.empty()) replaceProjectToken(token);
    }
    /// Sets the token of every part at once, before the object is shared with
    /// other threads.
    void replaceProjectToken(const boost::weak_ptr<const ThreadSafe>& token) {
        token_ = token;
        lock_ = lockOf(token);
    }

private:
    boost::weak_ptr<const ThreadSafe> token_;
    boost::shared_ptr<ReadWriteMutex> lock_;
};

} // namespace VelaMediaLib
