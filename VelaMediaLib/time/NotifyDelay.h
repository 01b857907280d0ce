#pragma once

#include <boost/shared_ptr.hpp>

namespace VelaMediaLib {

class Subject;
class ThreadSafe;

/// Holds back the ordinary notifications of one project while it lives; when
/// the last delay of that project ends, each held-back subject is told once,
/// in the order in which it first changed. A process-wide registry keeps, per
/// project, the number of live delays (or -1 while the held-back notifications
/// are being delivered) and the subjects waiting.
class NotifyDelay {
public:
    /// Throws VelaMediaLibException "nested delays not supported" when opened
    /// by an observer while the project's held-back notifications are delivered.
    explicit NotifyDelay(const boost::shared_ptr<const ThreadSafe>& token);
    ~NotifyDelay();
    NotifyDelay(const NotifyDelay&) = delete;
    NotifyDelay& operator=(const NotifyDelay&) = delete;

    static bool isActive(const boost::shared_ptr<const ThreadSafe>& token);
    static bool isNotifying(const boost::shared_ptr<const ThreadSafe>& token);
    static void addSubject(Subject* subject, const boost::shared_ptr<const ThreadSafe>& token);
    static void removeSubject(Subject* subject, const boost::shared_ptr<const ThreadSafe>& token);
    /// Forgets a subject wherever it waits (a subject destroyed while held back).
    static void removeSubject(Subject* subject);
    static void removeMappingForThreadSafe(const ThreadSafe* token);

private:
    void deliver();

    boost::shared_ptr<const ThreadSafe> token_;
};

} // namespace VelaMediaLib
