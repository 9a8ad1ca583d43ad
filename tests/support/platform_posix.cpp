#include "tests/support/platform.h"

#include <dlfcn.h>
#include <stdlib.h>
#include <sys/stat.h>

#include <array>
#include <cstdio>
#include <fstream>
#include <stdexcept>

namespace fs = std::filesystem;

fs::path makeTemporaryFolder() {
    std::string name = (fs::temp_directory_path() / "ovphotoXXXXXX").string();
    if (!mkdtemp(name.data())) throw std::runtime_error("no temporary folder");
    return name;
}

const bool printfIsExact = true;
const bool heapIsShared = true;

void setVariable(const char* name, const char* value) { setenv(name, value, 1); }

std::vector<fs::path> irregularFiles(const fs::path& folder) {
    const fs::path pipe = folder / "pipe", link = folder / "link";
    if (mkfifo(pipe.c_str(), 0600) != 0) throw std::runtime_error("no pipe");
    fs::create_symlink("pipe", link);
    return {pipe, link, "/dev/null"};
}

void compileCatalogue(const fs::path& file, const std::string& messages) {
    const std::string stem = file.string();
    std::ofstream(stem + ".msg", std::ios::binary) << "$ codeset=UTF-8\n$set 1\n" << messages << '\n';
    // gencat adds to a file that is there.
    const std::string command = "LC_ALL=C gencat '" + stem + ".new' '" + stem + ".msg'";
    if (std::system(command.c_str()) != 0) throw std::runtime_error(command);
    fs::rename(stem + ".new", file);
}

std::set<std::string> exportedNames(const fs::path& module) {
    std::set<std::string> names;
    FILE* const nm = popen(("nm -D --defined-only --format=posix '" + module.string() + "'").c_str(), "r");
    if (!nm) throw std::runtime_error("no shell");
    std::array<char, 512> line;
    while (std::fgets(line.data(), line.size(), nm)) {
        const std::string text = line.data();
        names.insert(text.substr(0, text.find(' ')));
    }
    if (pclose(nm) != 0) throw std::runtime_error("nm fails");
    return names;
}

bool isLoaded(const fs::path& module) {
    void* const handle = dlopen(module.c_str(), RTLD_NOW | RTLD_NOLOAD);
    if (handle) dlclose(handle);
    return handle != nullptr;
}
