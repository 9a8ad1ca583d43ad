#pragma once

#include "host/componentManager/castable.h"

namespace Ov {

/// Bytes of a device that lie ready in memory. A device may answer this interface beside RnBufferedIO, for speed: a
/// reader walks them directly, and gets what it does not find there through the device.
class RnInputWindow : public RnCastable {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x9d2f6b40, 0xc81311f0, 0xb05c7a1e, 0x42e6d938};

    /// @{
    /// The unread bytes from the device's position on, possibly none. `advanceTo` moves the position to one of them
    /// or behind the last. Every operation of the device may change the window.
    const char* next() const { return _next; }
    const char* limit() const { return _limit; }
    void advanceTo(const char* position) { _next = position; }
    /// @}

protected:
    /// @{
    /// What `next` and `limit` give, kept by the device.
    const char* _next = nullptr;
    const char* _limit = nullptr;
    /// @}
};

}  // namespace Ov
