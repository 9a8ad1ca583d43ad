#pragma once

#include <sys/wait.h>

#include <cstdlib>
#include <fstream>
#include <functional>
#include <iterator>
#include <nlohmann/json.hpp>
#include <sstream>
#include <string>
#include <vector>

#include "support/paths.h"
#include "support/tempFolder.h"

// The built tool as a process, and small IES files for it.

/// The folder of a tool for Windows that is tested instead, or null. What is a matter of POSIX is left out then.
inline const char* windowsTool() { return std::getenv("OVPHOTO_WINDOWS_TOOL"); }

inline std::string toolFolder() { return windowsTool() ? windowsTool() : binFolder(); }

inline std::string readBytes(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

struct ToolResult {
    int status = -1;
    std::string out, err;

    std::vector<nlohmann::ordered_json> json() const {
        std::vector<nlohmann::ordered_json> objects;
        std::istringstream lines(out);
        for (std::string line; std::getline(lines, line);) objects.push_back(nlohmann::ordered_json::parse(line));
        return objects;
    }
    bool says(const std::string& text) const { return (out + err).find(text) != std::string::npos; }
};

/// Runs a shell command in which `ovphoto` is the built tool, in the folder `folder`.
inline ToolResult runShell(const std::string& command, const TempFolder& folder, const std::string& input = "",
                           const std::string& tool = toolFolder()) {
    const TempFolder streams;
    streams.write("in", input);
    const std::string stem = streams.path().string();
    const std::string line = "cd '" + folder.path().string() + "' && export LC_ALL=C && ovphoto() { '" + tool +
                             "/ovphoto' \"$@\"; } && { " + command + "\n} <" + stem + "/in >" + stem + "/out 2>" +
                             stem + "/err";
    const int status = std::system(line.c_str());
    return {WIFEXITED(status) ? WEXITSTATUS(status) : -1, readBytes(stem + "/out"), readBytes(stem + "/err")};
}

inline ToolResult runTool(const std::string& arguments, const TempFolder& folder, const std::string& input = "") {
    return runShell("ovphoto " + arguments, folder, input);
}

/// Runs the tool with faults, "OVPHOTO_SIGNAL=2"; tests/tool/faults.cpp lists them.
inline ToolResult runFaulty(const std::string& faults, const std::string& arguments, const TempFolder& folder) {
    // The address sanitizer wants to be the first to be loaded.
    return runShell("env " + faults + " ASAN_OPTIONS=verify_asan_link_order=0 LD_PRELOAD='" + binFolder() +
                        "/libovphoto_faults.so' '" + toolFolder() + "/ovphoto' " + arguments,
                    folder);
}

/// An IES file; what a test does not set is as plain as can be.
struct IesFile {
    std::string tilt = "NONE", lamps = "1 -1", multiplier = "1";
    int type = 1;
    std::string factors = "1 1 0";
    std::vector<double> verticals{0, 45, 90}, horizontals{0};
    std::function<double(double, double)> candela = [](double, double) { return 100; };

    std::string text() const {
        std::ostringstream out;
        out << "IESNA91\n[TEST] one\nTILT=" << tilt << "\n" << lamps << " " << multiplier << " ";
        out << verticals.size() << " " << horizontals.size() << " " << type << " 2 0 0 0\n" << factors << "\n";
        for (double v : verticals) out << v << "\n";
        for (double h : horizontals) out << h << "\n";
        for (double h : horizontals) {
            for (double v : verticals) out << candela(v, h) << "\n";
        }
        return out.str();
    }
};

/// Angles from `first` to `last`, `step` apart.
inline std::vector<double> angles(double first, double last, double step) {
    std::vector<double> result;
    for (double a = first; a < last + step / 2; a += step) result.push_back(a);
    return result;
}
