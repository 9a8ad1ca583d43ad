#include "host/componentManager/postLoadList.h"

#include <memory>
#include <mutex>
#include <utility>

#include "components/support/immortal.h"

namespace Ov {

struct RnPostLoadList::Node {
    RnRef<RnPersistant> object;
    Node* next = nullptr;
};

/// Nodes between two uses.
class RnPostLoadList::Pool {
public:
    Node* take() {
        const std::lock_guard guard(_lock);
        if (!_free) return new Node;
        Node* node = std::exchange(_free, _free->next);
        node->next = nullptr;
        return node;
    }

    void give(Node* node) {
        const std::lock_guard guard(_lock);
        node->next = std::exchange(_free, node);
    }

private:
    std::mutex _lock;
    Node* _free = nullptr;
};

/// Lists of other static objects may end after this file's.
RnPostLoadList::Pool& RnPostLoadList::pool() { return immortal<Pool>(); }

RnPostLoadList::~RnPostLoadList() {
    try {
        finish();
    } catch (...) {
        // Nobody is left to hear of it.
    }
}

void RnPostLoadList::add(RnPersistant& object) {
    Node* node = pool().take();
    node->object = RnRef<RnPersistant>::share(&object);
    (_last ? _last->next : _first) = node;
    _last = node;
}

void RnPostLoadList::take(RnPostLoadList& other) {
    if (&other == this || other.empty()) return;
    (_last ? _last->next : _first) = std::exchange(other._first, nullptr);
    _last = std::exchange(other._last, nullptr);
}

RnRef<RnPersistant> RnPostLoadList::takeFirst() {
    Node* node = std::exchange(_first, _first->next);
    if (!_first) _last = nullptr;
    RnRef<RnPersistant> object = std::move(node->object);
    pool().give(node);
    return object;
}

void RnPostLoadList::finish() {
    // An object may add others from its loadFinished; they follow.
    try {
        while (!empty()) takeFirst()->loadFinished();
    } catch (...) {
        while (!empty()) takeFirst();
        throw;
    }
}

}  // namespace Ov
