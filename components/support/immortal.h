#pragma once

#include <cstddef>
#include <new>

namespace Ov {

/// The one object of a class, made on first use in static storage and never destroyed, so that it may be asked
/// until the process ends or the module goes. What it holds on the heap, a module lets go of when it is unloaded.
template <class T>
T& immortal() {
    alignas(T) static std::byte place[sizeof(T)];
    static T* const object = new (place) T;
    return *object;
}

}  // namespace Ov
