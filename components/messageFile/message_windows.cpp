#include <windows.h>

#include <cstdint>
#include <filesystem>

#include "components/messageFile/messageStore.h"
#include "components/messageFile/resourceCheck_windows.h"
#include "components/support/path.h"
#include "host/sdk/util.h"

namespace Ov {

namespace {

namespace fs = std::filesystem;

constexpr unsigned highestId = 0xFFFF;  // larger numbers would be taken modulo 65536
constexpr std::size_t bufferStep = 512;

/// The program or library that holds this code.
HMODULE ownModule() {
    HMODULE module = nullptr;
    GetModuleHandleExW(GET_MODULE_HANDLE_EX_FLAG_FROM_ADDRESS | GET_MODULE_HANDLE_EX_FLAG_UNCHANGED_REFCOUNT,
                       reinterpret_cast<const wchar_t*>(&ownModule), &module);
    return module;
}

/// While it lives, what is loaded is looked for as the module's own manifest says. Programs have none there.
class ActivationContext {
public:
    ActivationContext() {
        ACTCTXW manifest{};
        manifest.cbSize = sizeof manifest;
        manifest.dwFlags = ACTCTX_FLAG_HMODULE_VALID | ACTCTX_FLAG_RESOURCE_NAME_VALID;
        manifest.hModule = ownModule();
        manifest.lpResourceName = MAKEINTRESOURCEW(2);  // of a library that is isolated from its program
        _context = CreateActCtxW(&manifest);
        _active = _context != INVALID_HANDLE_VALUE && ActivateActCtx(_context, &_cookie);
    }
    ActivationContext(const ActivationContext&) = delete;
    ActivationContext& operator=(const ActivationContext&) = delete;
    ~ActivationContext() {
        if (_active) DeactivateActCtx(0, _cookie);
        if (_context != INVALID_HANDLE_VALUE) ReleaseActCtx(_context);
    }

private:
    HANDLE _context;
    ULONG_PTR _cookie = 0;
    bool _active;
};

/// The open resource file, or null. No code of it runs.
HMODULE openCatalogue(const fs::path& path) {
    std::error_code error;
    if (!fs::is_regular_file(path, error)) return nullptr;
    const ActivationContext ours;
    // A name without a folder would be looked for in the system's places.
    const HMODULE image = LoadLibraryExW(fs::absolute(path, error).c_str(), nullptr,
                                         LOAD_LIBRARY_AS_DATAFILE | LOAD_LIBRARY_AS_IMAGE_RESOURCE);
    // The lowest bits of the handle say how the file is mapped.
    const auto base = reinterpret_cast<std::uintptr_t>(image) & ~std::uintptr_t{3};
    if (!image || resourcesAreSound(reinterpret_cast<const void*>(base), fs::file_size(path, error))) return image;
    FreeLibrary(image);
    return nullptr;
}

}  // namespace

std::unique_ptr<RnMessageFile::Store> RnMessageFile::Store::open(const std::wstring& fileName) {
    const fs::path path = nativePath(fileName);
    const std::wstring language = WendSDK::Util::language();
    HMODULE catalogue = nullptr;
    if (!language.empty()) catalogue = openCatalogue(path.parent_path() / nativePath(language) / path.filename());
    if (!catalogue) catalogue = openCatalogue(path);
    return std::unique_ptr<Store>(catalogue ? new Store(catalogue) : nullptr);
}

RnMessageFile::Store::~Store() { FreeLibrary(static_cast<HMODULE>(_catalogue)); }

std::wstring RnMessageFile::Store::text(unsigned id) const {
    if (id > highestId) return {};
    const ActivationContext ours;
    std::wstring buffer;
    std::size_t copied = 0;
    do {
        buffer.resize(buffer.size() + bufferStep);
        const int room = static_cast<int>(buffer.size() - 1);
        copied = static_cast<std::size_t>(LoadStringW(static_cast<HMODULE>(_catalogue), id, buffer.data(), room));
    } while (copied + 2 >= buffer.size());  // with its terminator it fills the room: it may have been cut
    buffer.resize(copied);
    return buffer;
}

}  // namespace Ov
