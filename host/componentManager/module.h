#pragma once

#include <cstdint>
#include <string>

#include "host/base/hostApi.h"

namespace Ov {

class RnComponentRegistry;

/// A loaded module and its exports, by name and by ordinal. Unloaded with the object.
class OVHOST_API Module {
public:
    /// Loads the file; raises ExModule with the system's reason.
    explicit Module(const std::wstring& path);
    Module(const Module&) = delete;
    Module& operator=(const Module&) = delete;
    ~Module();

    /// The absolute path of the file.
    const std::wstring& path() const { return _path; }

    /// The address of an export, or null.
    void* byName(const char* name) const;
    /// The address of a numbered export, or null: asked from the system where modules have ordinals, else looked
    /// up in the module's table `RnNumberedExports`.
    void* byOrdinal(std::uint32_t ordinal) const;
    /// The same as a function of a given type, `byOrdinal<float(int)>(426)`.
    template <class Function>
    Function* byOrdinal(std::uint32_t ordinal) const {
        return reinterpret_cast<Function*>(byOrdinal(ordinal));
    }

    /// What the entry point answers; raises ExModule when there is none.
    RnComponentRegistry& registry() const;

private:
    /// The system's handle of the file loaded from this absolute path; raises ExModule.
    static void* load(const std::wstring& path);

    std::wstring _path;
    void* _handle;
};

}  // namespace Ov
