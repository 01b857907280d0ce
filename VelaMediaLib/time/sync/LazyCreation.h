#pragma once
// Parts of model objects made on first use by queries. A query runs under the
// project's read lock, possibly inside a reader's snapshot, so making such a
// part must not take the write lock (asking for it gives the read share up,
// and a writer could slip in). Instead a part is published with one
// compare-and-swap: readers see it whole or not at all, two threads making it
// at once keep one, and nobody waits. What is published is replaced or freed
// only under the project's write lock (when no one reads) or with its owner.

#include <atomic>
#include <boost/shared_ptr.hpp>
#include <string>

namespace VelaMediaLib {

/// An owned object made on first use.
template <typename T>
class LazyPtr {
public:
    LazyPtr() = default;
    ~LazyPtr() { delete get(); }
    LazyPtr(const LazyPtr&) = delete;
    LazyPtr& operator=(const LazyPtr&) = delete;

    T* get() const { return pointer_.load(std::memory_order_acquire); }

    /// The object, made with `make` (returning a new T) when there is none yet.
    template <typename Make>
    T& getOrMake(Make make) const {
        if (T* existing = get()) return *existing;
        T* made = make();
        T* expected = nullptr;
        if (pointer_.compare_exchange_strong(expected, made, std::memory_order_acq_rel,
                                             std::memory_order_acquire))
            return *made;
        delete made; // another thread's came first
        return *expected;
    }

    /// Replaces the object; only while no one else reads it.
    void reset(T* replacement = nullptr) { delete pointer_.exchange(replacement, std::memory_order_acq_rel); }
    T* release() { return pointer_.exchange(nullptr, std::memory_order_acq_rel); }

private:
    mutable std::atomic<T*> pointer_{nullptr};
};

/// Named shared values in name order, which readers walk without a lock of
/// their own while others add to them: entries are linked in with one
/// compare-and-swap and unlinked only under the write lock. Callers hold the
/// project's read lock to read or add, and its write lock to replace or erase.
template <typename V>
class NamedEntries {
public:
    typedef boost::shared_ptr<V> Pointer;

    NamedEntries() = default;
    ~NamedEntries() {
        for (Node* node = head_.load(std::memory_order_acquire); node;) {
            Node* next = node->next.load(std::memory_order_relaxed);
            delete node;
            node = next;
        }
    }
    NamedEntries(const NamedEntries&) = delete;
    NamedEntries& operator=(const NamedEntries&) = delete;

    Pointer find(const std::string& name) const {
        const Node* node = head_.load(std::memory_order_acquire);
        while (node && node->name < name) node = node->next.load(std::memory_order_acquire);
        return node && node->name == name ? node->value : Pointer();
    }

    /// The value of the name; when it has none, the candidate becomes it.
    Pointer insertIfAbsent(const std::string& name, const Pointer& candidate) {
        Node* fresh = nullptr;
        for (;;) {
            std::atomic<Node*>* link = &head_;
            Node* at = link->load(std::memory_order_acquire);
            while (at && at->name < name) {
                link = &at->next;
                at = link->load(std::memory_order_acquire);
            }
            if (at && at->name == name) {
                delete fresh;
                return at->value;
            }
            if (!fresh) fresh = new Node(name, candidate);
            fresh->next.store(at, std::memory_order_relaxed);
            if (link->compare_exchange_strong(at, fresh, std::memory_order_release,
                                              std::memory_order_relaxed))
                return candidate;
        }
    }

    /// Sets the value of the name (under the project's write lock).
    void set(const std::string& name, const Pointer& value) {
        Pointer kept = insertIfAbsent(name, value);
        if (kept == value) return;
        Node* node = head_.load(std::memory_order_acquire);
        while (node->name != name) node = node->next.load(std::memory_order_acquire);
        node->value = value;
    }

    /// Unlinks and frees the entry of the name, returning its value (null when
    /// there is none). Only under the project's write lock, when no one reads.
    Pointer erase(const std::string& name) {
        std::atomic<Node*>* link = &head_;
        Node* at = link->load(std::memory_order_acquire);
        while (at && at->name < name) {
            link = &at->next;
            at = link->load(std::memory_order_acquire);
        }
        if (!at || at->name != name) return Pointer();
        link->store(at->next.load(std::memory_order_acquire), std::memory_order_release);
        Pointer value = at->value;
        delete at;
        return value;
    }

    /// Calls `visit(name, value)` for each entry in name order.
    template <typename Visit>
    void forEach(Visit visit) const {
        for (const Node* node = head_.load(std::memory_order_acquire); node;
             node = node->next.load(std::memory_order_acquire))
            visit(node->name, node->value);
    }

private:
    struct Node {
        Node(const std::string& n, const Pointer& v) : name(n), value(v) {}
        const std::string name;
        Pointer value;
        std::atomic<Node*> next{nullptr};
    };
    std::atomic<Node*> head_{nullptr};
};

} // namespace VelaMediaLib
