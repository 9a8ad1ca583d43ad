#pragma once

#include <regex>
#include <string>

#include "plot/geometry.h"

/// Every point of the picture's longest path of lines: letters are curves.
inline OvPlot::Path longestPath(const std::string& svg) {
    static const std::regex path(R"re( d="([^"]*)")re"), point(R"(([-0-9.]+) ([-0-9.]+))");
    std::string longest;
    for (std::sregex_iterator match(svg.begin(), svg.end(), path), end; match != end; ++match)
        if (const std::string& drawn = (*match)[1]; drawn.size() > longest.size() && drawn.find('C') == drawn.npos)
            longest = drawn;
    OvPlot::Path points;
    for (std::sregex_iterator match(longest.begin(), longest.end(), point), end; match != end; ++match)
        points.push_back({std::stod((*match)[1]), std::stod((*match)[2])});
    return points;
}
