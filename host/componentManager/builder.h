#pragma once

#include <cstdint>

#include "host/componentManager/bufferedIO.h"
#include "host/componentManager/castable.h"
#include "host/componentManager/enumerator.h"

namespace Ov {

/// What a builder says of itself. Texts live as long as the module.
class OVHOST_API RnBuilderDescription : public RnCastable {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0xad148680, 0x719a11d1, 0xa3bb0060, 0x9707609d};

    /// Class id of what the builder creates.
    virtual const RnUid& getClassId() const = 0;
    /// The family shown to the user, such as "Photometric Web".
    virtual const wchar_t* getCategory() const = 0;

    /// @{
    /// For the user: the class's name, version, description, legal notice and vendor.
    virtual const wchar_t* getName() const = 0;
    virtual int getVersion() const = 0;
    virtual const wchar_t* getDescription() const = 0;
    virtual const wchar_t* getLegalNotice() const = 0;
    virtual const wchar_t* getVendor() const = 0;
    /// @}

    /// Whether a user may create the class directly.
    virtual bool isCreatable() const = 0;
};

/// Creates objects of one class.
class OVHOST_API RnComponentBuilder : public RnBuilderDescription {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0xad148681, 0x719a11d1, 0xa3bb0060, 0x9707609d};

    /// @{
    /// This builder with a new reference.
    virtual RnRefPtr<RnComponentBuilder> getBuilder();
    virtual RnCRefPtr<RnComponentBuilder> getBuilder() const;
    /// @}

    /// A new object with one reference; null when there is no memory.
    virtual RnRef<RnCastable> create() = 0;
};

/// Imports objects of one class from files; the second base of a builder.
///
/// Threads:  any number may use a builder at once, each with a device of its own.
class OVHOST_API RnImportBuilder : public RnCastable {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0xad148682, 0x719a11d1, 0xa3bb0060, 0x9707609d};

    /// Visits the format's file extensions, in lower case without a dot.
    virtual RnEnum::Action enumerateExtensions(RnEnumerator<const wchar_t*>& visitor) = 0;
    /// Whether the input at the current position looks like this format; the position is kept. Raises ExBadCast
    /// for a null device.
    virtual bool canImport(RnBufferedIO* io) = 0;
    /// The same for a file; false when it is not a regular file that can be opened.
    virtual bool canImport(const wchar_t* path, const wchar_t* basePath);
    /// A new object read from the input, with one reference. `name` and `basePath` go to its `load`. Raises
    /// RnStreamEx::ExReadError, after reported messages, when the input is refused.
    virtual RnRef<RnCastable> import(RnPtr<RnBufferedIO> io, const wchar_t* name, const wchar_t* basePath) = 0;
    /// The same for a file: the object is named after it, without folder and extension, and `basePath` is its
    /// folder unless one is given. A file that cannot be opened raises RnStreamEx::ExReadError.
    virtual RnRef<RnCastable> import(const wchar_t* path, const wchar_t* basePath);
};

/// A module's account of itself.
class OVHOST_API RnComponentDescription : public RnCastable {};

/// The builders of a module.
class OVHOST_API RnComponentRegistry : public RnComponentDescription {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0xad148683, 0x719a11d1, 0xa3bb0060, 0x9707609d};

    /// The builder of a class with a new reference, or null.
    virtual RnRef<RnComponentBuilder> getBuilder(const RnUid& classId) = 0;

    /// @{
    /// Of the module: version, legal notice, vendor.
    virtual int getVersion() const = 0;
    virtual const wchar_t* getLegalNotice() const = 0;
    virtual const wchar_t* getVendor() const = 0;
    /// @}

    /// How many builders there are.
    virtual std::uint32_t getBuilderCount() const = 0;
    /// Visits every builder once, in no particular order, then finishes.
    virtual RnEnum::Action enumerateBuilders(RnEnumerator<RnPtr<RnComponentBuilder>>& visitor) = 0;
};

}  // namespace Ov
