#pragma once

#include <filesystem>
#include <string>
#include <vector>

namespace OvTool {

/// A file to be read.
struct FoundFile {
    std::string path;
    bool fromFolder = false;  // found there instead of being named by the user
    std::string error;        // why a folder cannot be listed; empty for files
};

/// The files that the paths name: what is no folder as it is, and everything below the folders, by name. A folder
/// that cannot be listed stands in the result itself.
std::vector<FoundFile> expandPaths(const std::vector<std::string>& paths);

/// A path as the tool shows it: with slashes, on every system.
std::string pathText(const std::filesystem::path& path);

}  // namespace OvTool
