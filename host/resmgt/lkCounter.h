#pragma once

#include <atomic>

namespace Ov {

/// Atomic counter behind every counted object: any thread may raise or lower it.
template <class T>
class LkCounterWindows {
public:
    /// Counts from `start` on.
    explicit LkCounterWindows(T start) : _value(start) {}
    LkCounterWindows(const LkCounterWindows&) = delete;
    LkCounterWindows& operator=(const LkCounterWindows&) = delete;

    /// @{
    /// Both return the new value. Lowering orders everything done through a reference before the object's end.
    T operator++() { return _value.fetch_add(1, std::memory_order_relaxed) + 1; }
    T operator--() { return _value.fetch_sub(1, std::memory_order_acq_rel) - 1; }
    /// @}

    /// The value now.
    T value() const { return _value.load(std::memory_order_relaxed); }

private:
    std::atomic<T> _value;
};

}  // namespace Ov
