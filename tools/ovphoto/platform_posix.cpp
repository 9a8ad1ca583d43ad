#include <fcntl.h>
#include <unistd.h>

#include <csignal>

#include "tools/ovphoto/platform.h"

namespace OvTool {

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
    return std::filesystem::read_symlink("/proc/self/exe", error).parent_path();
}

const char* moduleFileName() { return "libOVphoto.so"; }

}  // namespace OvTool
