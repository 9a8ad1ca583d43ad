#include "tools/ovphoto/expandPaths.h"

#include <algorithm>
#include <filesystem>

#include "components/support/path.h"
#include "tools/ovphoto/platform.h"
#include "tools/ovphoto/standardStreams.h"
#include "tools/ovphoto/targetFormat.h"

namespace OvTool {

namespace fs = std::filesystem;

namespace {

void addFolder(const fs::path& folder, std::vector<FoundFile>& files) {
    std::error_code error;
    std::vector<fs::directory_entry> entries;
    for (fs::directory_iterator entry(folder, error), end; !error && entry != end; entry.increment(error)) {
        entries.push_back(*entry);
    }
    if (error) files.push_back({pathText(folder), false, "cannot be listed: " + error.message()});
    std::sort(entries.begin(), entries.end());
    for (const fs::directory_entry& entry : entries) {
        std::error_code ignored;
        // Links to folders are not followed: they may lead in circles.
        if (entry.is_directory(ignored) && !isLink(entry.path())) {
            addFolder(entry.path(), files);
        } else if (!entry.is_directory(ignored)) {
            files.push_back({pathText(entry.path()), true, {}});
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

bool hasPhotometricExtension(const std::string& path) { return targetOf(path) != nullptr; }

}  // namespace OvTool
