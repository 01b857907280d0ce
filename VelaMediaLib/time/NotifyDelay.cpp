#include <VelaMediaLib/time/NotifyDelay.h>

#include <VelaMediaLib/time/Subject.h>
#include <VelaMediaLib/time/ThreadSafe.h>
#include <VelaMediaLib/time/VelaMediaLibException.h>

#include <algorithm>
#include <map>
#include <mutex>
#include <vector>

namespace VelaMediaLib {
namespace {

struct ProjectState {
    int state = 0; // > 0: live delays; 0: idle; -1: delivering
    std::vector<Subject*> waiting;
};

struct Registry {
    std::mutex mutex;
    std::map<const ThreadSafe*, ProjectState> projects;
};

// Never destroyed: subjects may be destroyed during static destruction.
Registry& registry() {
    static Registry* instance = new Registry;
    return *instance;
}

int stateOf(const ThreadSafe* token) {
    Registry& r = registry();
    std::lock_guard<std::mutex> lock(r.mutex);
    const auto found = r.projects.find(token);
    return found == r.projects.end() ? 0 : found->second.state;
}

} // namespace

NotifyDelay::NotifyDelay(const boost::shared_ptr<const ThreadSafe>& token) : token_(token) {
    Registry& r = registry();
    std::lock_guard<std::mutex> lock(r.mutex);
    ProjectState& project = r.projects[token_.get()];
    if (project.state < 0) throw VelaMediaLibException("nested delays not supported");
    ++project.state;
}

NotifyDelay::~NotifyDelay() {
    {
        Registry& r = registry();
        std::lock_guard<std::mutex> lock(r.mutex);
        ProjectState& project = r.projects[token_.get()];
        if (--project.state > 0) return;
        project.state = -1;
    }
    deliver();
}

// Takes the waiting subjects one at a time, so that a subject destroyed by an
// observer during delivery is simply no longer there.
void NotifyDelay::deliver() {
    Registry& r = registry();
    for (;;) {
        Subject* next = nullptr;
        {
            std::lock_guard<std::mutex> lock(r.mutex);
            ProjectState& project = r.projects[token_.get()];
            if (project.waiting.empty()) {
                project.state = 0;
                return;
            }
            next = project.waiting.front();
            project.waiting.erase(project.waiting.begin());
            next->pendingInDelay_ = false;
        }
        try {
            next->tellOrdinaryObservers();
        } catch (...) {
            // An observer's failure must not stop the others from hearing.
        }
    }
}

bool NotifyDelay::isActive(const boost::shared_ptr<const ThreadSafe>& token) {
    return stateOf(token.get()) > 0;
}

bool NotifyDelay::isNotifying(const boost::shared_ptr<const ThreadSafe>& token) {
    return stateOf(token.get()) < 0;
}

void NotifyDelay::addSubject(Subject* subject, const boost::shared_ptr<const ThreadSafe>& token) {
    Registry& r = registry();
    std::lock_guard<std::mutex> lock(r.mutex);
    if (subject->pendingInDelay_) return;
    r.projects[token.get()].waiting.push_back(subject);
    subject->pendingInDelay_ = true;
}

void NotifyDelay::removeSubject(Subject* subject, const boost::shared_ptr<const ThreadSafe>&) {
    removeSubject(subject);
}

void NotifyDelay::removeSubject(Subject* subject) {
    Registry& r = registry();
    std::lock_guard<std::mutex> lock(r.mutex);
    if (!subject->pendingInDelay_) return;
    for (auto& entry : r.projects) {
        std::vector<Subject*>& waiting = entry.second.waiting;
        waiting.erase(std::remove(waiting.begin(), waiting.end(), subject), waiting.end());
    }
    subject->pendingInDelay_ = false;
}

void NotifyDelay::removeMappingForThreadSafe(const ThreadSafe* token) {
    Registry& r = registry();
    std::lock_guard<std::mutex> lock(r.mutex);
    const auto found = r.projects.find(token);
    if (found == r.projects.end()) return;
    for (Subject* subject : found->second.waiting) subject->pendingInDelay_ = false;
    r.projects.erase(found);
}

} // namespace VelaMediaLib
