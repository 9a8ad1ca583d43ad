#include "tools/ovphoto/platform.h"

#include <fcntl.h>
#include <spawn.h>
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

constexpr const char* self = "/proc/self/exe";

struct CloseFile {
    void operator()(std::FILE* file) const { std::fclose(file); }
};
using File = std::unique_ptr<std::FILE, CloseFile>;

/// A file without a name that started processes do not inherit.
File temporaryFile() {
    File file(std::tmpfile());
    if (file) ::fcntl(::fileno(file.get()), F_SETFD, FD_CLOEXEC);
    return file;
}

std::string contents(std::FILE* file) {
    std::string bytes;
    char block[4096];
    std::rewind(file);
    while (const std::size_t count = std::fread(block, 1, sizeof block, file)) bytes.append(block, count);
    return bytes;
}

/// Starts the tool with its output going to the files; 0, or the error.
int startSelf(const std::filesystem::path& path, std::vector<std::string>& arguments, std::FILE* out,
              std::FILE* err, pid_t& pid) {
    std::vector<char*> argv;
    std::string name = path.string();
    argv.push_back(name.data());
    for (std::string& argument : arguments) argv.push_back(argument.data());
    argv.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    if (const int error = ::posix_spawn_file_actions_init(&actions)) return error;
    ::posix_spawn_file_actions_adddup2(&actions, ::fileno(out), STDOUT_FILENO);
    ::posix_spawn_file_actions_adddup2(&actions, ::fileno(err), STDERR_FILENO);
    const int error = ::posix_spawn(&pid, path.c_str(), &actions, nullptr, argv.data(), environ);
    ::posix_spawn_file_actions_destroy(&actions);
    return error;
}

}  // namespace

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

std::filesystem::path executableFolder() {
    std::error_code error;
    return std::filesystem::read_symlink(self, error).parent_path();
}

const char* moduleFileName() { return "libOVphoto.so"; }

class SelfRunner::Processes {
public:
    Processes(std::vector<std::vector<std::string>> runs, std::size_t atOnce)
        : _arguments(std::move(runs)), _results(_arguments.size()), _atOnce(atOnce) {
        std::error_code error;
        _path = std::filesystem::read_symlink(self, error);
    }
    ~Processes() {
        while (!_running.empty()) waitForOne();
    }
    Processes(const Processes&) = delete;
    Processes& operator=(const Processes&) = delete;

    ProcessResult next() {
        const std::size_t run = _next++;
        startMore();
        while (isRunning(run)) {
            waitForOne();
            startMore();
        }
        return std::move(_results[run]);
    }

private:
    struct Process {
        std::size_t run;
        pid_t pid;
        File out;
        File err;
    };

    bool isRunning(std::size_t run) const {
        return std::any_of(_running.begin(), _running.end(), [run](const Process& p) { return p.run == run; });
    }

    void startMore() {
        for (; _running.size() < _atOnce && _started < _arguments.size(); ++_started) start(_started);
    }

    void start(std::size_t run) {
        Process process{run, 0, temporaryFile(), temporaryFile()};
        const bool ready = process.out && process.err;
        const int error =
            ready ? startSelf(_path, _arguments[run], process.out.get(), process.err.get(), process.pid) : errno;
        if (error == 0) {
            _running.push_back(std::move(process));
        } else {
            _results[run].err = "no process can be started: " + std::generic_category().message(error);
        }
    }

    void waitForOne() {
        int status = 0;
        const pid_t pid = ::waitpid(-1, &status, 0);
        if (pid == -1 && errno == EINTR) return;
        const auto ended = pid == -1 ? _running.begin()
                                     : std::find_if(_running.begin(), _running.end(),
                                                    [pid](const Process& p) { return p.pid == pid; });
        if (ended == _running.end()) return;
        const int exitStatus = pid != -1 && WIFEXITED(status) ? WEXITSTATUS(status) : -1;
        _results[ended->run] = {exitStatus, contents(ended->out.get()), contents(ended->err.get())};
        _running.erase(ended);
    }

    std::filesystem::path _path;
    std::vector<std::vector<std::string>> _arguments;
    std::vector<ProcessResult> _results;
    std::vector<Process> _running;
    std::size_t _atOnce;
    std::size_t _started = 0;
    std::size_t _next = 0;
};

SelfRunner::SelfRunner(std::vector<std::vector<std::string>> runs, std::size_t atOnce)
    : _processes(std::make_unique<Processes>(std::move(runs), atOnce)) {}
SelfRunner::~SelfRunner() = default;
ProcessResult SelfRunner::next() { return _processes->next(); }

}  // namespace OvTool
