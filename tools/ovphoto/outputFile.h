#pragma once

#include <memory>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "tools/ovphoto/platform.h"

namespace OvTool {

/// Files that are written together, all of them whole or none. Each goes to a new file beside its place, and is put
/// there when all are complete and on the disk; until then, and when that fails, what was there stays as it is. Links
/// are followed, and the permissions of a file that is replaced are kept. Read-only files are not replaced. What was
/// not put in place goes with the object, or with the process, be it that a signal ends it. Of one thread.
class OutputFiles {
public:
    OutputFiles();
    OutputFiles(const OutputFiles&) = delete;
    OutputFiles& operator=(const OutputFiles&) = delete;
    ~OutputFiles();

    /// @{
    /// Empty, or why it failed: "cannot be written: ...".
    std::string add(const std::string& file, std::string_view bytes);
    std::string putInPlace();
    /// @}

private:
    struct File;

    void putBack(std::size_t count);

    std::vector<std::unique_ptr<File>> _files;
};

/// Writes a single one, or standard output as "-".
std::string writeFile(const std::string& file, std::string_view bytes);

/// Removes what is not in its place yet, in a process that breaks off.
void removeUnfinishedFiles();

/// Files that are read, and so must not be written.
class InputFiles {
public:
    InputFiles() = default;
    explicit InputFiles(const std::vector<std::string>& files);

    void add(const std::string& file);
    /// Why a file is not written: it is one of these, by whatever name or link. Empty where it is none.
    std::string refusal(const std::string& file) const;

private:
    std::set<FileIdentity> _files;
};

}  // namespace OvTool
