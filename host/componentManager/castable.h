#pragma once

#include "host/base/exBase.h"
#include "host/componentManager/ref.h"
#include "host/componentManager/uid.h"

#include <typeinfo>

namespace Ov {

/// Root of every object that passes between host and modules: reached through interfaces asked for by id, and
/// counted. The order of the operations is part of the contract with compiled modules.
///
/// References: an object counts its holders minus one. `getInterface` returns a pointer that carries one new
/// reference; whoever holds a reference releases it. References may be taken and dropped on any thread.
class OVHOST_API RnCastable {
public:
    /// @{
    /// The object itself, whatever interface it is asked through; no new reference.
    virtual RnCastable* getCastable() = 0;
    virtual const RnCastable* getCastable() const = 0;
    /// @}

    /// The part of this object that answers for `iid`, with a new reference, or null without one. The result is
    /// the castable base of exactly that interface, so a static_cast to the interface is right.
    virtual RnCastable* getInterface(const RnUid& iid) = 0;
    /// Whether `getInterface` would answer; takes no reference.
    virtual bool hasInterface(const RnUid& iid) const = 0;

    /// A place in the table of operations; does nothing.
    virtual void reserved();

    /// @{
    /// Take and drop a reference; the result is the new count, below 0 once the object is gone. These base
    /// versions are for static objects: they count nothing and destroy nothing.
    virtual long newReference() const;
    virtual long release() const;
    /// @}

    virtual ~RnCastable();

    /// Raises ExBadCast.
    [[noreturn]] static void throwBadCast();
};

/// An object does not answer the interface that somebody needs of it.
class OVHOST_API ExBadCast : public ExBase, public std::bad_cast {
public:
    ExBadCast();
    ~ExBadCast() override;
    /// The reason.
    const char* what() const noexcept override;
};

/// The framework's fallback for an interface that an object does not answer itself: asks the registered
/// translators in turn (none are registered by default). Null, or an object with one reference.
OVHOST_API RnCastable* RnTranslateInterface(RnCastable* object, const RnUid& iid);

/// Answers as RnTranslateInterface does.
using RnTranslator = RnCastable* (*)(RnCastable* object, const RnUid& iid);

/// @{
/// Host side: adds and removes a translator, while nothing is being cast.
OVHOST_API void RnAddTranslator(RnTranslator translator);
OVHOST_API void RnRemoveTranslator(RnTranslator translator);
/// @}

/// The interface `I` of an object: its own, else a translation, else null.
template <class I>
RnRef<I> rnQuery(RnCastable* object) {
    if (!object) return {};
    RnCastable* found = object->getInterface(I::iid);
    if (!found) found = RnTranslateInterface(object, I::iid);
    return RnRef<I>::adopt(static_cast<I*>(found));
}

/// As `rnQuery`, but a null object or a missing interface raises ExBadCast.
template <class I>
RnRef<I> rnCast(RnCastable* object) {
    RnRef<I> result = rnQuery<I>(object);
    if (!result) RnCastable::throwBadCast();
    return result;
}

}  // namespace Ov
