#include "tools/ovphoto/platform.h"

#include <dirent.h>
#include <fcntl.h>
#include <poll.h>
#include <spawn.h>
#include <sys/auxv.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstdio>
#include <system_error>

extern char** environ;

namespace OvTool {

namespace {

struct CloseFile {
    void operator()(std::FILE* file) const { std::fclose(file); }
};
using File = std::unique_ptr<std::FILE, CloseFile>;

void require(int error) {
    if (error != 0) throw std::system_error(error, std::generic_category());
}

/// A file without a name that started processes do not inherit.
File temporaryFile() {
    File file(std::tmpfile());
    if (!file) require(errno);
    ::fcntl(::fileno(file.get()), F_SETFD, FD_CLOEXEC);
    return file;
}

std::string contents(std::FILE* file) {
    std::string bytes;
    char block[4096];
    std::rewind(file);
    while (const std::size_t count = std::fread(block, 1, sizeof block, file)) bytes.append(block, count);
    return bytes;
}

class Descriptor {
public:
    explicit Descriptor(int descriptor) : _descriptor(descriptor) {}
    Descriptor(const Descriptor&) = delete;
    Descriptor& operator=(const Descriptor&) = delete;
    ~Descriptor() {
        if (_descriptor != -1) ::close(_descriptor);
    }
    int get() const { return _descriptor; }

private:
    int _descriptor;
};

std::error_code lastError() { return {errno, std::generic_category()}; }

std::error_code synced(int descriptor) {
    // Not every file system knows how.
    const bool done = ::fsync(descriptor) == 0 || errno == EINVAL || errno == ENOTSUP || errno == ENOSYS;
    return done ? std::error_code() : lastError();
}

constexpr int endingSignals[] = {SIGHUP, SIGINT, SIGQUIT, SIGTERM, SIGXCPU};

const sigset_t& endings() {
    static const sigset_t set = [] {
        sigset_t signals;
        ::sigemptyset(&signals);
        for (const int signal : endingSignals) ::sigaddset(&signals, signal);
        return signals;
    }();
    return set;
}

int holders = 0;
sigset_t maskBefore;
void (*workBeforeEnd)() = nullptr;

extern "C" void endBySignal(int signal) {
    workBeforeEnd();
    std::signal(signal, SIG_DFL);
    std::raise(signal);  // comes when this returns
}

/// This program's file. Where /proc is not mounted, the name that it was started by is followed.
std::filesystem::path executable() {
    std::error_code error;
    const auto path = std::filesystem::read_symlink("/proc/self/exe", error);
    if (!error) return path;
    const auto* started = reinterpret_cast<const char*>(::getauxval(AT_EXECFN));
    return started ? std::filesystem::canonical(started, error) : std::filesystem::path();
}

}  // namespace

struct Process {
    Process() = default;
    Process(const Process&) = delete;
    Process& operator=(const Process&) = delete;
    ~Process() {
        while (pid > 0 && ::waitpid(pid, nullptr, 0) == -1 && errno == EINTR) {
        }
    }

    pid_t pid = 0;  // 0 before it is started and after it has been waited for
    File out = temporaryFile();
    File err = temporaryFile();
};

void prepareStandardStreams() {
    std::signal(SIGPIPE, SIG_IGN);
    std::signal(SIGXFSZ, SIG_IGN);
    // A closed stream is replaced by one that fails: the input can only be written, the outputs only be read.
    const int modes[] = {O_WRONLY, O_RDONLY, O_RDONLY};
    for (int stream = 0; stream < 3; ++stream) {
        // The lowest free descriptor is the one that was closed.
        if (::fcntl(stream, F_GETFD) == -1 && ::open("/dev/null", modes[stream]) == -1) return;
    }
}

bool standardErrorIsTerminal() { return ::isatty(STDERR_FILENO) != 0; }

bool standardOutputIsClosedPipe() {
    pollfd output{STDOUT_FILENO, 0, 0};
    struct stat status = {};
    const bool isPipe =
        ::fstat(STDOUT_FILENO, &status) == 0 && (S_ISFIFO(status.st_mode) || S_ISSOCK(status.st_mode));
    return isPipe && ::poll(&output, 1, 0) == 1 && (output.revents & (POLLERR | POLLHUP)) != 0;
}

std::vector<std::string> commandLine(int argc, char** argv) { return {argv + std::min(argc, 1), argv + argc}; }

std::filesystem::path executableFolder() { return executable().parent_path(); }

// The standard library's own iterator ends the process where memory runs out.
std::vector<std::filesystem::path> pathsIn(const std::filesystem::path& folder, std::error_code& error) {
    std::vector<std::filesystem::path> paths;
    const std::unique_ptr<DIR, int (*)(DIR*)> opened(opendir(folder.empty() ? "." : folder.c_str()), closedir);
    errno = opened ? 0 : errno;
    while (const dirent* const entry = opened ? readdir(opened.get()) : nullptr) {
        const std::string_view name = entry->d_name;
        if (name != "." && name != "..") paths.push_back(folder / name);
        errno = 0;
    }
    error.assign(errno, std::generic_category());
    std::sort(paths.begin(), paths.end());
    return paths;
}

bool isLink(const std::filesystem::path& folder) {
    std::error_code ignored;
    return std::filesystem::is_symlink(folder, ignored);
}

const char* moduleFileName() { return "libOVphoto.so"; }

std::optional<FileIdentity> identityOf(const std::filesystem::path& file) {
    struct stat found {};
    if (::stat(file.c_str(), &found) != 0) return {};
    return FileIdentity{found.st_dev, found.st_ino};
}

bool isWritable(const std::filesystem::path& file) {
    // The superuser may write everything, and means a file that nobody may write as everyone does.
    struct stat found {};
    const bool toSome = ::stat(file.c_str(), &found) == 0 && (found.st_mode & (S_IWUSR | S_IWGRP | S_IWOTH)) != 0;
    return toSome && ::faccessat(AT_FDCWD, file.c_str(), W_OK, AT_EACCESS) == 0;
}

std::error_code writeNewFile(const std::filesystem::path& file, std::string_view bytes) {
    const Descriptor to(::open(file.c_str(), O_WRONLY | O_CREAT | O_EXCL | O_CLOEXEC, 0666));
    if (to.get() == -1) return lastError();
    while (!bytes.empty()) {
        const ssize_t count = ::write(to.get(), bytes.data(), bytes.size());
        if (count == -1 && errno == EINTR) continue;
        if (count == -1) return lastError();
        bytes.remove_prefix(static_cast<std::size_t>(count));
    }
    return synced(to.get());
}

std::error_code syncFolder(const std::filesystem::path& folder) {
    const Descriptor names(::open(folder.c_str(), O_RDONLY | O_DIRECTORY | O_CLOEXEC));
    // A folder may be one to write into that nobody can list.
    return names.get() == -1 ? std::error_code() : synced(names.get());
}

void SignalsHeld::hold() {
    if (holders++ == 0) ::pthread_sigmask(SIG_BLOCK, &endings(), &maskBefore);
}

void SignalsHeld::release() {
    if (--holders == 0) ::pthread_sigmask(SIG_SETMASK, &maskBefore, nullptr);
}

void runBeforeEnd(void (*work)()) {
    workBeforeEnd = work;
    struct sigaction action {};
    action.sa_handler = endBySignal;
    action.sa_mask = endings();
    for (const int signal : endingSignals) {
        struct sigaction before {};
        const bool ignored = ::sigaction(signal, nullptr, &before) == 0 && before.sa_handler == SIG_IGN;
        if (!ignored) ::sigaction(signal, &action, nullptr);
    }
}

void removeAtOnce(const std::filesystem::path& file) noexcept { ::unlink(file.c_str()); }

std::shared_ptr<Process> startSelf(const std::vector<std::string>& arguments) {
    auto process = std::make_shared<Process>();
    std::vector<std::string> texts{executable().string()};
    texts.insert(texts.end(), arguments.begin(), arguments.end());
    std::vector<char*> argv;
    for (std::string& text : texts) argv.push_back(text.data());
    argv.push_back(nullptr);

    posix_spawn_file_actions_t actions;
    require(::posix_spawn_file_actions_init(&actions));
    ::posix_spawn_file_actions_adddup2(&actions, ::fileno(process->out.get()), STDOUT_FILENO);
    ::posix_spawn_file_actions_adddup2(&actions, ::fileno(process->err.get()), STDERR_FILENO);
    const int failure = ::posix_spawn(&process->pid, argv[0], &actions, nullptr, argv.data(), environ);
    ::posix_spawn_file_actions_destroy(&actions);
    require(failure);
    return process;
}

std::pair<std::size_t, ProcessResult> waitForOne(const std::vector<std::shared_ptr<Process>>& processes) {
    for (;;) {
        int status = 0;
        const pid_t pid = ::waitpid(-1, &status, 0);
        if (pid == -1 && errno == EINTR) continue;
        // Where nothing is left to wait for, the first has ended unseen.
        const auto ended = std::find_if(processes.begin(), processes.end(),
                                        [pid](const auto& process) { return pid == -1 || process->pid == pid; });
        if (ended == processes.end()) continue;
        (*ended)->pid = 0;
        const int exitStatus = pid != -1 && WIFEXITED(status) ? WEXITSTATUS(status) : -1;
        return {static_cast<std::size_t>(ended - processes.begin()),
                {exitStatus, contents((*ended)->out.get()), contents((*ended)->err.get())}};
    }
}

}  // namespace OvTool
