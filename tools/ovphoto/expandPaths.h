#pragma once

#include <string>
#include <vector>

namespace OvTool {

/// A file to be read, and whether it was found in a folder instead of being named by the user.
struct FoundFile {
    std::string path;
    bool fromFolder = false;
};

/// The files that the paths name: what is no folder as it is, and everything below the folders, by name. A folder
/// that cannot be listed stands in the result itself, so that reading it fails.
std::vector<FoundFile> expandPaths(const std::vector<std::string>& paths);

/// Whether the file's extension is that of a photometric format: ies, cib, nmb or tbt.
bool hasPhotometricExtension(const std::string& path);

}  // namespace OvTool
