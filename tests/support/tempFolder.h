#pragma once

#include <stdlib.h>

#include <filesystem>
#include <fstream>
#include <string>
#include <string_view>

#include "host/platform/path.h"

/// A folder for one test, deleted with the object.
class TempFolder {
public:
    TempFolder() {
        std::string name = (std::filesystem::temp_directory_path() / "ovphotoXXXXXX").string();
        _path = mkdtemp(name.data());
    }
    TempFolder(const TempFolder&) = delete;
    TempFolder& operator=(const TempFolder&) = delete;
    ~TempFolder() {
        std::error_code ignored;
        std::filesystem::remove_all(_path, ignored);
    }

    const std::filesystem::path& path() const { return _path; }
    /// The wide path of the folder, or of `name` in it.
    std::wstring wide(const std::string& name = "") const {
        return Ov::widePath(name.empty() ? _path : _path / name);
    }
    /// Writes a file, in folders that are made for it; its wide path.
    std::wstring write(const std::string& name, std::string_view bytes) const {
        std::filesystem::create_directories((_path / name).parent_path());
        std::ofstream(_path / name, std::ios::binary) << bytes;
        return wide(name);
    }

private:
    std::filesystem::path _path;
};
