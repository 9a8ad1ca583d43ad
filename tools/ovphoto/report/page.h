#pragma once

#include "tools/ovphoto/pictures/drawnFile.h"

namespace OvTool {

/// A file as a page shows it; what depends on the module has been asked.
struct Datasheet {
    DrawnFile file;
    std::vector<std::string> remarks;  // what reading reported and what a user should know
    OvPlot::Diagram diagram;
};

Datasheet datasheetOf(DrawnFile file);

/// The page; any number of threads may make pages. `indexUrl` leads back to an index and may be empty.
std::string datasheetPage(const Datasheet& sheet, const std::string& indexUrl);

/// Its light as a small picture, its ids starting with `prefix`.
std::string thumbnail(const Datasheet& sheet, const std::string& prefix);

}  // namespace OvTool
