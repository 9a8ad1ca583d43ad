#include "tools/ovphoto/outputFile.h"

#include <cerrno>
#include <filesystem>
#include <fstream>
#include <iostream>
#include <random>
#include <system_error>

#include "host/platform/path.h"
#include "tools/ovphoto/standardStreams.h"

namespace OvTool {

namespace fs = std::filesystem;

namespace {

/// A file of a new name that is removed unless it is kept under another.
class TemporaryFile {
public:
    explicit TemporaryFile(const fs::path& folder) : _path(folder / newName()) {}
    TemporaryFile(const TemporaryFile&) = delete;
    TemporaryFile& operator=(const TemporaryFile&) = delete;
    ~TemporaryFile() {
        std::error_code ignored;
        fs::remove(_path, ignored);
    }

    /// Writes everything and closes; false with errno set.
    bool write(std::string_view bytes) {
        errno = 0;
        std::ofstream file(_path, std::ios::binary);
        file.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        file.close();
        return !file.fail();
    }
    /// Gives the file its final name.
    std::error_code renameTo(const fs::path& target) {
        std::error_code error;
        const fs::file_status old = fs::status(target, error);
        if (fs::exists(old)) fs::permissions(_path, old.permissions(), error);
        fs::rename(_path, target, error);
        return error;
    }

private:
    static std::string newName() {
        std::random_device random;
        return ".ovphoto-" + std::to_string(random()) + std::to_string(random()) + ".tmp";
    }

    fs::path _path;
};

}  // namespace

std::string writeFile(const std::string& file, std::string_view bytes) {
    if (isStandardStream(file)) {
        std::cout.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        return {};  // the end of the tool tells of output that fails
    }
    std::error_code error;
    fs::path target = Ov::nativePath(Ov::fromUtf8(file));
    const fs::file_status status = fs::status(target, error);
    if (fs::is_directory(status)) return "cannot be written: is a folder";
    if (fs::exists(status) && !fs::is_regular_file(status)) return "cannot be written: is no regular file";
    if (fs::exists(status)) target = fs::canonical(target, error);

    TemporaryFile temporary(target.parent_path());
    if (!temporary.write(bytes)) {
        return "cannot be written: " + std::generic_category().message(errno ? errno : EIO);
    }
    if (const std::error_code failure = temporary.renameTo(target)) {
        return "cannot be written: " + failure.message();
    }
    return {};
}

}  // namespace OvTool
