#pragma once

#include <span>

#include "plot/diagram.h"
#include "tools/ovphoto/beamAngles.h"
#include "tools/ovphoto/luminaireFile.h"

namespace OvTool {

/// A file that was read and is to be shown.
struct DrawnFile {
    ReadResult source;  // with a web
    std::vector<BeamAngles> angles;
    WebLight light;  // in candela
};

/// None when the file is refused; `result` then has the reasons.
std::optional<DrawnFile> drawnFile(const HostSession& session, ReadResult& result);

/// What the luminaire is called in the file, else the file's name.
std::string titleOf(const DrawnFile& file);

/// The diagram of the lights of one file or several; it refers to them.
OvPlot::Diagram diagramOf(std::span<const DrawnFile> files);

}  // namespace OvTool
