#include "tools/ovphoto/expandPaths.h"

#include <algorithm>
#include <filesystem>

#include "components/support/path.h"
#include "tools/ovphoto/platform.h"
#include "tools/ovphoto/standardStreams.h"

namespace OvTool {

namespace fs = std::filesystem;

namespace {

void addFolder(const fs::path& folder, std::vector<FoundFile>& files) {
    std::error_code error;
    const std::vector<fs::path> entries = pathsIn(folder, error);
    if (error) files.push_back({pathText(folder), false, "cannot be listed: " + error.message()});
    for (const fs::path& entry : entries) {
        std::error_code ignored;
        // Links to folders are not followed: they may lead in circles.
        if (!fs::is_directory(entry, ignored)) {
            files.push_back({pathText(entry), true, {}});
        } else if (!isLink(entry)) {
            addFolder(entry, files);
        }
    }
}

}  // namespace

std::vector<FoundFile> expandPaths(const std::vector<std::string>& paths) {
    std::vector<FoundFile> files;
    for (const std::string& path : paths) {
        std::error_code error;
        const fs::path native = Ov::nativePath(Ov::fromUtf8(path));
        if (!isStandardStream(path) && fs::is_directory(native, error)) {
            addFolder(native, files);
        } else {
            files.push_back({path, false, {}});
        }
    }
    return files;
}

std::string pathText(const fs::path& path) {
    std::string text = Ov::toUtf8(Ov::widePath(path));
    if (fs::path::preferred_separator != '/') std::replace(text.begin(), text.end(), '\\', '/');
    return text;
}

}  // namespace OvTool
