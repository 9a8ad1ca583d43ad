#pragma once

#include <filesystem>
#include <fstream>
#include <stdexcept>
#include <string>
#include <string_view>

#include "components/support/path.h"
#include "tests/support/platform.h"

/// A folder for one test, deleted with the object.
class TempFolder {
public:
    TempFolder() : _path(makeTemporaryFolder()) {}
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;
    ~TempFolder() {
        std::error_code ignored;
        std::filesystem::remove_all(_path, ignored);
    }

    const std::filesystem::path& path() const { return _path; }
    /// The wide path of the folder, or of `name` in it.
    std::wstring wide(const std::string& name = "") const {
        return Ov::widePath(name.empty() ? _path : pathOf(name));
    }
    /// Writes a file, in folders that are made for it; its wide path.
    std::wstring write(const std::string& name, std::string_view bytes) const {
        std::filesystem::create_directories(pathOf(name).parent_path());
        std::ofstream file(pathOf(name), std::ios::binary);
        if (!(file << bytes).flush()) throw std::runtime_error(name + " cannot be written");
        return wide(name);
    }

private:
    std::filesystem::path pathOf(const std::string& name) const {
        return _path / Ov::nativePath(Ov::fromUtf8(name));
    }

    const std::filesystem::path _path;
};
