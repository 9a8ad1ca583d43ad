#pragma once

#include <new>
#include <utility>

#include "host/componentManager/castable.h"
#include "host/componentManager/persistant.h"
#include "host/resmgt/lkCounter.h"

// How a class takes part in the framework, written once. A class lists the interfaces it answers, most derived
// first, and picks what it needs:
//
//     RnCastImpl<Base, I...>            answers the interfaces I..., all bases of Base
//     RnCastImpl2<Base, Second, I...>   the same for a class with a second base; Second answers with its own part
//     RnCastHeap<Impl>                  counted; deletes itself on its last release
//     RnTempIface<Impl, Self, Adapter>  answers RnPersistant with a new Adapter for this object
//     RnTempObject<Data>                what such an adapter derives from: holds a reference to its data object
//
// A static object (a builder, the registry) uses RnCastImpl or RnCastImpl2 alone and is never deleted.

namespace Ov {

namespace detail {

template <class Object>
RnCastable* findInterface(Object&, const RnUid&) {
    return nullptr;
}

template <class Object, class First, class... Rest>
RnCastable* findInterface(Object& object, const RnUid& id, First*, Rest*... rest) {
    if (id == First::iid) {
        First& part = object;
        part.newReference();
        return &part;
    }
    return findInterface(object, id, rest...);
}

}  // namespace detail

/// Answers the interfaces, all of them bases of `Base`. On its own it makes static objects.
template <class Base, class... Interfaces>
class RnCastImpl : public Base {
public:
    using Base::Base;
    /// @cond
    RnCastable* getCastable() override { return this; }
    const RnCastable* getCastable() const override { return this; }
    RnCastable* getInterface(const RnUid& id) override {
        return detail::findInterface(*this, id, static_cast<Interfaces*>(nullptr)...);
    }
    bool hasInterface(const RnUid& id) const override { return ((id == Interfaces::iid) || ...); }
    /// @endcond
};

/// The same for a class with a second base, which answers with its own part.
template <class Base, class Second, class... Interfaces>
class RnCastImpl2 : public Base, public Second {
public:
    /// @cond
    RnCastable* getCastable() override { return static_cast<Base*>(this); }
    const RnCastable* getCastable() const override { return static_cast<const Base*>(this); }
    RnCastable* getInterface(const RnUid& id) override {
        return detail::findInterface(*this, id, static_cast<Interfaces*>(nullptr)...,
                                     static_cast<Second*>(nullptr));
    }
    bool hasInterface(const RnUid& id) const override {
        return ((id == Interfaces::iid) || ...) || id == Second::iid;
    }
    void reserved() override {}
    long newReference() const override { return Base::newReference(); }
    long release() const override { return Base::release(); }
    /// @endcond
};

/// Counted: deletes itself on its last release.
template <class Impl>
class RnCastHeap : public Impl {
public:
    using Impl::Impl;
    RnCastHeap() = default;
    /// A copy has its own holders.
    RnCastHeap(const RnCastHeap& other) : Impl(other) {}
    RnCastHeap& operator=(const RnCastHeap&) = delete;

    /// @cond
    long newReference() const override { return ++_count; }
    long release() const override {
        const long count = --_count;
        if (count < 0) delete this;
        return count;
    }
    /// @endcond

private:
    mutable LkCounterWindows<long> _count{-1};
};

/// A new counted object with one reference. Throws what the constructor throws, std::bad_alloc included.
template <class T, class... Args>
RnRef<T> rnCreate(Args&&... args) {
    return RnRef<T>::share(new T(std::forward<Args>(args)...));
}

/// As a builder's `create` wants it: a null reference when there is no memory.
template <class T>
RnRef<RnCastable> rnCreateOrNull() noexcept {
    try {
        return RnRef<RnCastable>::share(rnCreate<T>()->getCastable());
    } catch (const std::bad_alloc&) {
        return {};
    }
}

/// Answers RnPersistant with a new `Adapter` for this object.
template <class Impl, class Self, class Adapter>
class RnTempIface : public Impl {
public:
    using Impl::Impl;
    /// @cond
    RnCastable* getInterface(const RnUid& id) override {
        if (id == RnPersistant::iid) return rnCreate<Adapter>(static_cast<Self&>(*this)).detach();
        return Impl::getInterface(id);
    }
    bool hasInterface(const RnUid& id) const override { return id == RnPersistant::iid || Impl::hasInterface(id); }
    /// @endcond
};

/// A data object: counted, answers `Interfaces` (Base derives from them) and saves itself through `Adapter`.
template <class Self, class Adapter, class Base, class... Interfaces>
using RnDataObject = RnCastHeap<RnTempIface<RnCastImpl<Base, Interfaces...>, Self, Adapter>>;

/// The same for a class with a second base.
template <class Self, class Adapter, class Base, class Second, class... Interfaces>
using RnDataObject2 = RnCastHeap<RnTempIface<RnCastImpl2<Base, Second, Interfaces...>, Self, Adapter>>;

/// Base of such adapters: holds a reference to its data object, whose `Data::classId` is saved with it.
template <class Data>
class RnTempObject : public RnCastHeap<RnCastImpl<RnPersistant, RnPersistant>> {
public:
    /// Keeps `data` alive.
    explicit RnTempObject(Data& data) : _data(RnRef<Data>::share(&data)) {}

    /// @{
    /// What is saved in front of the object.
    const RnUid& getClassId() const override { return Data::classId; }
    int getVersion() const override { return 1; }
    /// @}

protected:
    /// The object to save or load.
    Data& data() const { return *_data; }

private:
    RnRef<Data> _data;
};

}  // namespace Ov
