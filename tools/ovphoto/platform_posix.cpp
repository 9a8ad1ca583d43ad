#include "tools/ovphoto/platform.h"

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
    pid_t pid = 0;
    File out = temporaryFile();
    File err = temporaryFile();
};

void prepareStandardStreams() {
    std::signal(SIGPIPE, SIG_IGN);
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

bool isLink(const std::filesystem::path& folder) {
    std::error_code ignored;
    return std::filesystem::is_symlink(folder, ignored);
}

const char* moduleFileName() { return "libOVphoto.so"; }

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
        const int exitStatus = pid != -1 && WIFEXITED(status) ? WEXITSTATUS(status) : -1;
        return {static_cast<std::size_t>(ended - processes.begin()),
                {exitStatus, contents((*ended)->out.get()), contents((*ended)->err.get())}};
    }
}

}  // namespace OvTool
