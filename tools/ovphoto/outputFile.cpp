#include "tools/ovphoto/outputFile.h"

#include <iostream>
#include <list>
#include <optional>
#include <random>

#include "components/support/path.h"
#include "tools/ovphoto/standardStreams.h"

namespace OvTool {

namespace fs = std::filesystem;

namespace {

fs::path nativeOf(const std::string& file) { return Ov::nativePath(Ov::fromUtf8(file)); }

fs::path folderOf(const fs::path& file) {
    const fs::path folder = file.parent_path();
    return folder.empty() ? "." : folder;
}

/// Names of files that are to go when the process breaks off, or a signal ends it. Changed while signals are held.
std::list<fs::path>& unfinished() {
    static std::list<fs::path> files;
    return files;
}

/// A name for a new file beside another that goes with the object, and so does its file.
class TemporaryName {
public:
    explicit TemporaryName(const fs::path& beside) {
        [[maybe_unused]] static const bool prepared = (unfinished(), runBeforeEnd(removeUnfinishedFiles), true);
        std::random_device random;
        const std::string name = ".ovphoto-" + std::to_string(random()) + std::to_string(random()) + ".tmp";
        const SignalsHeld held;
        unfinished().push_front(beside.parent_path() / name);
        _place = unfinished().begin();
    }
    TemporaryName(const TemporaryName&) = delete;
    TemporaryName& operator=(const TemporaryName&) = delete;
    ~TemporaryName() {
        removeAtOnce(*_place);
        const SignalsHeld held;
        unfinished().erase(_place);
    }

    const fs::path& path() const { return *_place; }

private:
    std::list<fs::path>::iterator _place;
};

std::string failure(const std::string& reason) { return "cannot be written: " + reason; }
std::string failure(const std::error_code& error) { return failure(error.message()); }

/// Where a file that is to be written goes, links followed, and what is there; why it cannot be written, or empty.
std::string findTarget(const std::string& file, fs::path& target, fs::file_status& old) {
    std::error_code error;
    target = nativeOf(file);
    old = fs::status(target, error);
    if (old.type() == fs::file_type::none) return failure(error);  // links in a circle among others
    if (fs::is_directory(old)) return failure("is a folder");
    if (!fs::exists(old)) {
        const bool dangles = fs::is_symlink(fs::symlink_status(target, error));
        return dangles ? failure("is a link that leads to nothing") : std::string();
    }
    if (!fs::is_regular_file(old)) return failure("is no regular file");
    if (!isWritable(target)) return failure("is read-only");
    target = fs::canonical(target, error);
    return error ? failure(error) : std::string();
}

/// Gives a file a second name or, where the file system has no such, a copy.
std::error_code keepAs(const fs::path& name, const fs::path& file) {
    std::error_code error;
    fs::create_hard_link(file, name, error);
    if (error) fs::copy_file(file, name, error);
    return error;
}

}  // namespace

struct OutputFiles::File {
    fs::path target;
    bool replaces;  // a file that is there
    TemporaryName written;
    std::optional<TemporaryName> before;
};

OutputFiles::OutputFiles() = default;
OutputFiles::~OutputFiles() = default;

std::string OutputFiles::add(const std::string& file, std::string_view bytes) {
    fs::path target;
    fs::file_status old;
    if (std::string refusal = findTarget(file, target, old); !refusal.empty()) return refusal;
    const bool replaces = fs::exists(old);
    _files.push_back(std::unique_ptr<File>(new File{target, replaces, TemporaryName(target), {}}));
    const fs::path& written = _files.back()->written.path();
    std::error_code error = writeNewFile(written, bytes);
    if (!error && replaces) fs::permissions(written, old.permissions(), error);
    return error ? failure(error) : std::string();
}

std::string OutputFiles::putInPlace() {
    std::set<fs::path> folders;
    for (const auto& file : _files) folders.insert(folderOf(file->target));
    for (const fs::path& folder : folders)
        if (const std::error_code error = syncFolder(folder)) return failure(error);

    const SignalsHeld held;
    for (std::size_t i = 0; i < _files.size(); ++i) {
        File& file = *_files[i];
        std::error_code error;
        if (file.replaces && _files.size() > 1)
            error = keepAs(file.before.emplace(file.target).path(), file.target);
        if (!error) fs::rename(file.written.path(), file.target, error);
        if (!error) continue;
        putBack(i);
        return failure(error);
    }
    for (const fs::path& folder : folders) syncFolder(folder);
    return {};
}

/// Undoes what was done with the first files.
void OutputFiles::putBack(std::size_t count) {
    std::error_code ignored;
    while (count-- > 0) {
        const File& file = *_files[count];
        file.replaces ? fs::rename(file.before->path(), file.target, ignored)
                      : static_cast<void>(fs::remove(file.target, ignored));
    }
}

std::string writeFile(const std::string& file, std::string_view bytes) {
    if (isStandardStream(file)) {
        std::cout.write(bytes.data(), static_cast<std::streamsize>(bytes.size()));
        return {};  // the end of the tool tells of output that fails
    }
    OutputFiles files;
    const std::string error = files.add(file, bytes);
    return error.empty() ? files.putInPlace() : error;
}

void removeUnfinishedFiles() {
    for (const fs::path& file : unfinished()) removeAtOnce(file);
}

InputFiles::InputFiles(const std::vector<std::string>& files) {
    for (const std::string& file : files) add(file);
}

void InputFiles::add(const std::string& file) {
    if (const auto identity = identityOf(nativeOf(isStandardStream(file) ? "/dev/stdin" : file)))
        _files.insert(*identity);
}

std::string InputFiles::refusal(const std::string& file) const {
    const auto identity = isStandardStream(file) ? std::nullopt : identityOf(nativeOf(file));
    const bool isInput = identity && _files.contains(*identity);
    return isInput ? "is not written: it is one of the files to read" : "";
}

}  // namespace OvTool
