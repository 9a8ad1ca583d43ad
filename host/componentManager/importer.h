#pragma once

#include <string>

#include "host/componentManager/builder.h"

namespace Ov {

/// Imports files of a family of formats without being told which.
///
/// Threads:  any number may import at once, by one importer, too, each from a file or device of its own. The texts of
///           `getFileTypes` and `getDefaultSearch` belong to the importer: one thread at a time asks it for them.
class OVHOST_API RnImporter : public RnCastable {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0x81c8df25, 0xa78111d1, 0x988a4445, 0x53540000};

    /// The category of the builders to draw on.
    virtual const wchar_t* getImportCategory() const = 0;
    /// Visits those builders in order of their names.
    virtual RnEnum::Action enumerateObjects(RnEnumerator<RnCPtr<RnImportBuilder>>& visitor) = 0;
    /// The file types offered to the user: "Name (*.ext)|*.ext" entries, separated by "|"; the first, "All (...)",
    /// has every extension of the family. Empty when no builder is there.
    virtual const wchar_t* getFileTypes() = 0;

    /// @{
    /// Import a file. The builder is the first whose content test accepts it; null when none does, and then
    /// `recognised` is false. A file that cannot be read or is refused raises RnStreamEx::ExReadError.
    virtual RnRef<RnCastable> import(const wchar_t* path, const wchar_t* basePath, bool& recognised) = 0;
    virtual RnRef<RnCastable> import(const wchar_t* path, const wchar_t* basePath) = 0;
    virtual RnRef<RnCastable> import(RnPtr<RnBufferedIO> io, const wchar_t* name, const wchar_t* basePath) = 0;
    /// @}

    /// The pattern that a file dialog starts with: every extension of the family, "*.cib;*.ies".
    virtual const wchar_t* getDefaultSearch() = 0;
};

/// All of an importer but its category. It imports by the first builder of its own walk that accepts the input. Texts
/// stay valid until the same operation is called again.
class OVHOST_API RnBaseImporter : public RnImporter {
public:
    RnEnum::Action enumerateObjects(RnEnumerator<RnCPtr<RnImportBuilder>>& visitor) override;
    const wchar_t* getFileTypes() override;
    RnRef<RnCastable> import(const wchar_t* path, const wchar_t* basePath, bool& recognised) override;
    RnRef<RnCastable> import(const wchar_t* path, const wchar_t* basePath) override;
    RnRef<RnCastable> import(RnPtr<RnBufferedIO> io, const wchar_t* name, const wchar_t* basePath) override;
    const wchar_t* getDefaultSearch() override;

private:
    std::wstring _fileTypes;
    std::wstring _search;
};

}  // namespace Ov
