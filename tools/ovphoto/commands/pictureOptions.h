#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tools/ovphoto/commands/daylightOptions.h"

namespace OvTool {

enum class PictureKind { polar, cartesian, cone, isolux, solid, sky, sunPath };

struct PlotOptions {
    std::vector<std::string> files;
    std::string out;
    std::string format;  // "svg", "png" or "pdf"; empty: as `out` ends
    std::string as;
    PictureKind kind = PictureKind::polar;
    std::vector<double> planes{0, 90};
    std::optional<double> height;  // m
    int width = 600;               // pixels
    int rows = 600;
    bool dark = false;
    DaylightOptions daylight;
};

struct ReportOptions {
    std::vector<std::string> paths;
    std::string out;
    std::string as;
};

/// @{
/// What the commands do; the exit status. A build without Cairo says so, as wrong usage.
int runPlot(const PlotOptions& options, const HostSession& session);
int runReport(const ReportOptions& options, const HostSession& session);
/// @}

}  // namespace OvTool
