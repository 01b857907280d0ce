#pragma once

#include <VelaMediaLib/base/Export.h>

#include <boost/weak_ptr.hpp>

namespace VelaMediaLib {

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

protected:
    ProjectToken() = default;
    explicit ProjectToken(const boost::weak_ptr<const ThreadSafe>& token) : token_(token) {}
    ProjectToken(const ProjectToken&) = default;
    ProjectToken& operator=(const ProjectToken&) = default;
    ~ProjectToken() = default;

    /// Records the token a part was constructed with, unless it is empty.
    void recordProjectToken(const boost::weak_ptr<const ThreadSafe>& token) {
        if (!token.empty()) token_ = token;
    }
    /// Sets the token of every part at once, before the object is shared with
    /// other threads.
    void replaceProjectToken(const boost::weak_ptr<const ThreadSafe>& token) { token_ = token; }

private:
    boost::weak_ptr<const ThreadSafe> token_;
};

} // namespace VelaMediaLib
