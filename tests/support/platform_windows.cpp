#include "tests/support/platform.h"

#include <windows.h>

#include <array>
#include <cstdlib>
#include <map>
#include <sstream>
#include <stdexcept>
#include <vector>

#include "components/support/path.h"
#include "support/paths.h"

namespace fs = std::filesystem;

namespace {

void require(bool done, const char* what) {
    if (!done) throw std::runtime_error(std::string(what) + " fails with " + std::to_string(GetLastError()));
}

/// String resources come in blocks of 16: each text behind its length, that of a text which is missing is 0.
using Block = std::array<std::wstring, 16>;

std::map<unsigned, Block> blocksOf(const std::string& messages) {
    std::map<unsigned, Block> blocks;
    std::istringstream lines(messages);
    for (std::string line; std::getline(lines, line);) {
        std::size_t digits = 0;
        const auto id = static_cast<unsigned>(std::stoul(line, &digits));
        blocks[id / 16 + 1][id % 16] = Ov::fromUtf8(line).substr(digits + 1);
    }
    return blocks;
}

std::wstring unitsOf(const Block& block) {
    std::wstring units;
    for (const std::wstring& text : block) units += static_cast<wchar_t>(text.size()) + text;
    return units;
}

template <class T>
const T* at(HMODULE image, DWORD offset) {
    return reinterpret_cast<const T*>(reinterpret_cast<const char*>(image) + offset);
}

}  // namespace

fs::path makeTemporaryFolder() {
    static unsigned next = 0;
    for (;;) {
        const std::string name = "ovphoto" + std::to_string(GetCurrentProcessId()) + "_" + std::to_string(next++);
        const fs::path folder = fs::temp_directory_path() / name;
        if (fs::create_directory(folder)) return folder;
    }
}

const bool heapIsShared = false;
const bool printfIsExact = false;  // MinGW: "% u" of 1, "%#.o" of 0, "%025.28G" of 1e21

void setVariable(const char* name, const char* value) { _putenv_s(name, value); }

std::vector<fs::path> irregularFiles(const fs::path&) { return {}; }

void compileCatalogue(const fs::path& file, const std::string& messages) {
    // A file in use is put aside.
    std::error_code ignored;
    fs::rename(file, fs::path(file) += ".old" + std::to_string(GetTickCount64()), ignored);
    fs::copy_file(binFolder() + "/libOVphotoRes.dll", file);
    const HANDLE update = BeginUpdateResourceW(file.c_str(), TRUE);
    require(update, "BeginUpdateResource");
    for (const auto& [id, block] : blocksOf(messages)) {
        std::wstring units = unitsOf(block);
        require(UpdateResourceW(update, RT_STRING, MAKEINTRESOURCEW(id), 0, units.data(),
                                static_cast<DWORD>(units.size() * sizeof(wchar_t))),
                "UpdateResource");
    }
    require(EndUpdateResourceW(update, FALSE), "EndUpdateResource");
}

std::set<std::string> exportedNames(const fs::path& module) {
    const HMODULE image = LoadLibraryExW(fs::absolute(module).c_str(), nullptr, DONT_RESOLVE_DLL_REFERENCES);
    require(image, "LoadLibraryEx");
    const auto* headers =
        at<IMAGE_NT_HEADERS>(image, static_cast<DWORD>(at<IMAGE_DOS_HEADER>(image, 0)->e_lfanew));
    const auto& directory = headers->OptionalHeader.DataDirectory[IMAGE_DIRECTORY_ENTRY_EXPORT];
    const auto* exports = at<IMAGE_EXPORT_DIRECTORY>(image, directory.VirtualAddress);
    std::set<std::string> names;
    for (DWORD i = 0; i < exports->NumberOfNames; ++i)
        names.insert(at<char>(image, at<DWORD>(image, exports->AddressOfNames)[i]));
    FreeLibrary(image);
    return names;
}

bool isLoaded(const fs::path& module) { return GetModuleHandleW(fs::absolute(module).c_str()) != nullptr; }
