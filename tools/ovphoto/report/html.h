#pragma once

#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "plot/picture.h"

// Pieces of pages. What comes from files passes `escaped` on its way in.

namespace OvTool {

using OvPlot::escaped;

/// A text that pages hold as it is.
struct Asset {
    std::string_view text;
    std::string_view hash;  // SHA-256 in base 64, by which a page's policy lets it in
};

/// A whole page that needs nothing from outside, and is told to ask for nothing. `title` is escaped here, `body`
/// is markup.
std::string htmlPage(const std::string& title, const std::string& body, const Asset& script);

/// A table of two columns with a caption; texts are escaped here.
std::string factTable(const std::string& caption, const std::vector<std::pair<std::string, std::string>>& rows);

/// A picture that Cairo wrote as SVG, as part of a page: `prefix` keeps its ids from those of others.
std::string inlineSvg(std::string svg, const std::string& prefix);

/// A text as part of a relative link.
std::string urlPart(std::string_view text);

/// Of pages about files and of indices.
extern const Asset& pageScript;
extern const Asset& indexScript;

}  // namespace OvTool
