#pragma once

#include <utility>

namespace Ov {

/// A pointer that passes an object on without counting: the callee takes no reference unless it keeps the object.
template <class T>
class RnPtr {
public:
    RnPtr() = default;
    /// Implicit, for arguments.
    RnPtr(T* object) : _object(object) {}

    /// @{
    /// The object; null when there is none.
    T* get() const { return _object; }
    T* operator->() const { return _object; }
    T& operator*() const { return *_object; }
    explicit operator bool() const { return _object != nullptr; }
    /// @}

private:
    T* _object = nullptr;
};

/// The same of an object that is not to be changed.
template <class T>
using RnCPtr = RnPtr<const T>;

/// Owner of one reference to a counted object, or of none.
template <class T>
class RnRef {
public:
    RnRef() = default;
    /// Takes over a reference that the caller holds.
    static RnRef adopt(T* object) { return RnRef(object); }
    /// Takes a new reference.
    static RnRef share(T* object) {
        if (object) object->newReference();
        return RnRef(object);
    }

    /// @{
    /// A copy takes a new reference, a move the one that there was.
    RnRef(const RnRef& other) : RnRef(share(other._object)) {}
    RnRef(RnRef&& other) noexcept : _object(other.detach()) {}
    template <class U>
    RnRef(const RnRef<U>& other) : RnRef(share(other.get())) {}
    template <class U>
    RnRef(RnRef<U>&& other) noexcept : _object(other.detach()) {}
    ~RnRef() {
        if (_object) _object->release();
    }
    RnRef& operator=(RnRef other) noexcept {
        std::swap(_object, other._object);
        return *this;
    }
    /// @}

    /// @{
    /// The object; null when there is none.
    T* get() const { return _object; }
    T* operator->() const { return _object; }
    T& operator*() const { return *_object; }
    explicit operator bool() const { return _object != nullptr; }
    /// @}

    /// Gives the reference up to the caller.
    T* detach() { return std::exchange(_object, nullptr); }

private:
    explicit RnRef(T* object) : _object(object) {}

    T* _object = nullptr;
};

/// Owner of a reference to an object that is not to be changed.
template <class T>
using RnCRef = RnRef<const T>;

/// @{
/// Names under which the builder interfaces return counted pointers to themselves.
template <class T>
using RnRefPtr = RnRef<T>;
template <class T>
using RnCRefPtr = RnRef<const T>;
/// @}

}  // namespace Ov
