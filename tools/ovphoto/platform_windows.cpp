#include "tools/ovphoto/platform.h"

#include <windows.h>

#include <fcntl.h>
#include <io.h>

#include <algorithm>
#include <mutex>

#include "components/support/path.h"

/// The C library's way to the wide arguments, with wildcards expanded.
extern "C" int __wgetmainargs(int* argc, wchar_t*** argv, wchar_t*** environment, int expand, int* newMode);

namespace OvTool {

namespace {

struct CloseHandleOf {
    void operator()(HANDLE handle) const { CloseHandle(handle); }
};
using Handle = std::unique_ptr<void, CloseHandleOf>;

void require(bool done) {
    if (!done) throw std::system_error(static_cast<int>(GetLastError()), std::system_category());
}

/// A file that is gone when it is closed. Processes inherit it only while they are started.
Handle temporaryFile() {
    wchar_t name[MAX_PATH];
    const std::filesystem::path folder = std::filesystem::temp_directory_path();
    require(GetTempFileNameW(folder.c_str(), L"ovp", 0, name) != 0);
    const HANDLE file = CreateFileW(name, GENERIC_READ | GENERIC_WRITE, 0, nullptr, CREATE_ALWAYS,
                                    FILE_ATTRIBUTE_TEMPORARY | FILE_FLAG_DELETE_ON_CLOSE, nullptr);
    require(file != INVALID_HANDLE_VALUE);
    return Handle(file);
}

std::string contents(HANDLE file) {
    std::string bytes;
    char block[4096];
    DWORD count = 0;
    SetFilePointer(file, 0, nullptr, FILE_BEGIN);
    while (ReadFile(file, block, sizeof block, &count, nullptr) && count > 0) bytes.append(block, count);
    return bytes;
}

/// While it lives, started processes inherit the handle.
class Inherited {
public:
    explicit Inherited(HANDLE handle) : _handle(handle) { set(HANDLE_FLAG_INHERIT); }
    Inherited(const Inherited&) = delete;
    Inherited& operator=(const Inherited&) = delete;
    ~Inherited() { set(0); }

private:
    void set(DWORD flag) { SetHandleInformation(_handle, HANDLE_FLAG_INHERIT, flag); }

    HANDLE _handle;
};

/// An argument between quotes. Backslashes count double before a quote, and only there.
std::wstring quoted(const std::wstring& argument) {
    std::wstring text = L"\"";
    std::size_t backslashes = 0;
    for (const wchar_t c : argument) {
        if (c == L'"') text.append(backslashes + 1, L'\\');
        backslashes = c == L'\\' ? backslashes + 1 : 0;
        text += c;
    }
    return text.append(backslashes, L'\\') + L'"';
}

std::error_code lastError() { return {static_cast<int>(GetLastError()), std::system_category()}; }

std::recursive_mutex ending;
void (*workBeforeEnd)() = nullptr;

/// Ctrl-C, a window that is closed, the end of the session: told in a thread of the system's.
BOOL WINAPI endByConsole(DWORD) {
    const std::lock_guard lock(ending);
    workBeforeEnd();
    return FALSE;  // and now what is usual
}

std::wstring executablePath() {
    std::wstring path;
    DWORD length = 0;
    do {
        path.resize(path.size() + MAX_PATH);
        length = GetModuleFileNameW(nullptr, path.data(), static_cast<DWORD>(path.size()));
    } while (length == path.size());
    path.resize(length);
    return path;
}

}  // namespace

struct Process {
    Process() = default;
    Process(const Process&) = delete;
    Process& operator=(const Process&) = delete;
    ~Process() {
        if (handle) WaitForSingleObject(handle.get(), INFINITE);
    }

    Handle handle;
    Handle out = temporaryFile();
    Handle err = temporaryFile();
};

void prepareStandardStreams() {
    for (int stream = 0; stream < 3; ++stream) _setmode(stream, _O_BINARY);
    SetConsoleOutputCP(CP_UTF8);
}

bool standardOutputIsClosedPipe() {
    const HANDLE output = GetStdHandle(STD_OUTPUT_HANDLE);
    DWORD written = 0;
    return GetFileType(output) == FILE_TYPE_PIPE && !WriteFile(output, "", 0, &written, nullptr) &&
           (GetLastError() == ERROR_NO_DATA || GetLastError() == ERROR_BROKEN_PIPE);
}

bool standardErrorIsTerminal() {
    // One that takes the control sequences that terminals of other systems take.
    const HANDLE console = GetStdHandle(STD_ERROR_HANDLE);
    DWORD mode = 0;
    return GetConsoleMode(console, &mode) && SetConsoleMode(console, mode | ENABLE_VIRTUAL_TERMINAL_PROCESSING);
}

std::vector<std::string> commandLine(int, char**) {
    int argc = 0;
    wchar_t** argv = nullptr;
    wchar_t** environment = nullptr;
    int newMode = 0;
    __wgetmainargs(&argc, &argv, &environment, 1, &newMode);
    std::vector<std::string> arguments;
    for (int i = 1; i < argc; ++i) arguments.push_back(Ov::toUtf8(argv[i]));
    return arguments;
}

std::filesystem::path executableFolder() { return std::filesystem::path(executablePath()).parent_path(); }

std::vector<std::filesystem::path> pathsIn(const std::filesystem::path& folder, std::error_code& error) {
    std::vector<std::filesystem::path> paths;
    for (std::filesystem::directory_iterator entry(folder, error), end; !error && entry != end;
         entry.increment(error))
        paths.push_back(entry->path());
    std::sort(paths.begin(), paths.end());
    return paths;
}

bool isLink(const std::filesystem::path& folder) {
    WIN32_FIND_DATAW found{};
    const HANDLE search = FindFirstFileW(folder.c_str(), &found);
    if (search == INVALID_HANDLE_VALUE) return false;
    FindClose(search);
    // Folders that a cloud keeps are marked, too, and are none.
    return (found.dwFileAttributes & FILE_ATTRIBUTE_REPARSE_POINT) != 0 &&
           (found.dwReserved0 == IO_REPARSE_TAG_SYMLINK || found.dwReserved0 == IO_REPARSE_TAG_MOUNT_POINT);
}

const char* moduleFileName() { return "libOVphoto.dll"; }

std::optional<FileIdentity> identityOf(const std::filesystem::path& file) {
    const HANDLE opened = CreateFileW(file.c_str(), 0, FILE_SHARE_READ | FILE_SHARE_WRITE | FILE_SHARE_DELETE,
                                      nullptr, OPEN_EXISTING, FILE_FLAG_BACKUP_SEMANTICS, nullptr);
    if (opened == INVALID_HANDLE_VALUE) return {};
    const Handle handle(opened);
    BY_HANDLE_FILE_INFORMATION found{};
    if (!GetFileInformationByHandle(handle.get(), &found)) return {};
    return FileIdentity{found.dwVolumeSerialNumber,
                        (std::uint64_t{found.nFileIndexHigh} << 32) | found.nFileIndexLow};
}

bool isWritable(const std::filesystem::path& file) {
    const DWORD attributes = GetFileAttributesW(file.c_str());
    return attributes != INVALID_FILE_ATTRIBUTES && (attributes & FILE_ATTRIBUTE_READONLY) == 0;
}

std::error_code writeNewFile(const std::filesystem::path& file, std::string_view bytes) {
    // Others may remove it: that is how it goes when the process is to end.
    const HANDLE opened = CreateFileW(file.c_str(), GENERIC_WRITE, FILE_SHARE_READ | FILE_SHARE_DELETE, nullptr,
                                      CREATE_NEW, FILE_ATTRIBUTE_NORMAL, nullptr);
    if (opened == INVALID_HANDLE_VALUE) return lastError();
    const Handle handle(opened);
    while (!bytes.empty()) {
        constexpr std::size_t most = 1 << 30;
        DWORD count = 0;
        if (!WriteFile(handle.get(), bytes.data(), static_cast<DWORD>(std::min(bytes.size(), most)), &count,
                       nullptr))
            return lastError();
        bytes.remove_prefix(count);
    }
    return FlushFileBuffers(handle.get()) ? std::error_code() : lastError();
}

std::error_code syncFolder(const std::filesystem::path&) { return {}; }  // the system has no call for it

void SignalsHeld::hold() { ending.lock(); }

void SignalsHeld::release() { ending.unlock(); }

void runBeforeEnd(void (*work)()) {
    workBeforeEnd = work;
    SetConsoleCtrlHandler(endByConsole, TRUE);
}

void removeAtOnce(const std::filesystem::path& file) noexcept { DeleteFileW(file.c_str()); }

std::shared_ptr<Process> startSelf(const std::vector<std::string>& arguments) {
    auto process = std::make_shared<Process>();
    const std::wstring path = executablePath();
    std::wstring line = quoted(path);
    for (const std::string& argument : arguments) line += L' ' + quoted(Ov::fromUtf8(argument));

    STARTUPINFOW startup{};
    startup.cb = sizeof startup;
    startup.dwFlags = STARTF_USESTDHANDLES;
    startup.hStdInput = GetStdHandle(STD_INPUT_HANDLE);
    startup.hStdOutput = process->out.get();
    startup.hStdError = process->err.get();
    const Inherited out(process->out.get()), err(process->err.get());
    PROCESS_INFORMATION started{};
    require(CreateProcessW(path.c_str(), line.data(), nullptr, nullptr, TRUE, 0, nullptr, nullptr, &startup,
                           &started));
    CloseHandle(started.hThread);
    process->handle.reset(started.hProcess);
    return process;
}

std::pair<std::size_t, ProcessResult> waitForOne(const std::vector<std::shared_ptr<Process>>& processes) {
    std::vector<HANDLE> handles;
    for (const auto& process : processes) handles.push_back(process->handle.get());
    const std::size_t count = std::min<std::size_t>(handles.size(), MAXIMUM_WAIT_OBJECTS);
    const DWORD place = WaitForMultipleObjects(static_cast<DWORD>(count), handles.data(), FALSE, INFINITE);
    require(place < count);
    const Process& ended = *processes[place];
    DWORD status = 0;
    GetExitCodeProcess(ended.handle.get(), &status);
    // A process that breaks off has an error of the system for a status.
    const int exitStatus = status < 0x80000000 ? static_cast<int>(status) : -1;
    return {place, {exitStatus, contents(ended.out.get()), contents(ended.err.get())}};
}

}  // namespace OvTool
