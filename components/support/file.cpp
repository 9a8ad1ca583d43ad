#include "components/support/file.h"

#include <cerrno>
#include <fstream>
#include <system_error>

#include "components/support/path.h"

namespace Ov {

namespace {

namespace fs = std::filesystem;

/// A base of its own, so that the file is there before the device over it and closed after it.
struct InputFile {
    explicit InputFile(const fs::path& path) : file(path, std::ios::binary) {}
    std::ifstream file;
};

class FileBuffer final : private InputFile, public RnInBuffer {
public:
    explicit FileBuffer(const fs::path& path) : InputFile(path), RnInBuffer(&file) {}
    bool isOpen() const { return file.is_open(); }
};

std::string openReason(const fs::path& path) {
    std::error_code error;
    switch (fs::status(path, error).type()) {
        case fs::file_type::not_found:
            return "no such file";
        case fs::file_type::directory:
            return "it is a folder";
        case fs::file_type::none:
            return error.message();
        case fs::file_type::regular:
            break;
        default:
            return "it is not a regular file";
    }
    errno = 0;
    if (std::ifstream(path).is_open()) return "it could not be opened";  // it can by now
    return std::generic_category().message(errno);
}

}  // namespace

RnRef<RnBufferedIO> openInputFile(const wchar_t* path) {
    if (!path) return {};
    const fs::path native = nativePath(path);
    std::error_code ignored;
    if (!fs::is_regular_file(native, ignored)) return {};
    auto device = rnCreate<FileBuffer>(native);
    if (!device->isOpen()) return {};
    return device;
}

std::string openFailure(const wchar_t* path) {
    const std::wstring name = path ? path : L"";
    return toUtf8(name) + ": " + openReason(nativePath(name));
}

}  // namespace Ov
