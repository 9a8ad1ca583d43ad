#pragma once

#include <algorithm>
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

/// What holds all points of a path.
inline OvPlot::Box extentOf(const OvPlot::Path& path) {
    OvPlot::Box box{1e9, 1e9, 0, 0};
    for (const OvPlot::Point& p : path)
        box = {std::min(box.left, p.x), std::min(box.top, p.y), std::max(box.right, p.x),
               std::max(box.bottom, p.y)};
    return box;
}
