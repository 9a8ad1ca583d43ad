#pragma once

#include "host/componentManager/persistant.h"

namespace Ov {

/// Objects of a stream whose `loadFinished` is due. Emptying the list, or its end, calls each in turn and lets
/// go of it. The nodes come from one pool of the process, guarded by a lock.
class OVHOST_API RnPostLoadList {
public:
    RnPostLoadList() = default;
    RnPostLoadList(const RnPostLoadList&) = delete;
    RnPostLoadList& operator=(const RnPostLoadList&) = delete;
    ~RnPostLoadList();

    /// Takes a reference on `object`.
    void add(RnPersistant& object);
    /// Moves all objects of `other` behind those of this list.
    void take(RnPostLoadList& other);
    /// Calls `loadFinished` of each object in the order they were added. What a call throws is passed on; the
    /// objects behind it are let go of without a call.
    void finish();
    /// Whether nothing is due.
    bool empty() const { return !_first; }

private:
    struct Node;
    class Pool;
    static Pool& pool();
    RnRef<RnPersistant> takeFirst();

    Node* _first = nullptr;
    Node* _last = nullptr;
};

}  // namespace Ov
