#pragma once

#include "tools/ovphoto/beamAngles.h"
#include "tools/ovphoto/lightFile.h"
#include "tools/plot/diagram.h"

namespace OvTool {

/// A file that was read and is to be shown.
struct DrawnFile {
    ReadResult source;  // with a web
    std::vector<BeamAngles> angles;
    WebLight light;  // with the values of the file: candela, or candela per 1000 lm
};

/// None when the file is refused; `result` then has the reasons.
std::optional<DrawnFile> drawnFile(const HostSession& session, ReadResult& result);

/// What the luminaire is called in the file, else the file's name.
std::string titleOf(const DrawnFile& file);

/// @{
/// The diagram of one file's light, or of several: in candela or, where a file holds none, all of them per 1000
/// lm. It refers to `lights`, which it adds to.
OvPlot::Diagram diagramOf(const HostSession& session, const DrawnFile& file, std::vector<WebLight>& lights);
OvPlot::Diagram diagramOf(const HostSession& session, const std::vector<DrawnFile>& files,
                          std::vector<WebLight>& lights);
/// @}
/// The same of one file in candela, as illuminances need them; NIMB files hold none.
OvPlot::Diagram trueDiagramOf(const HostSession& session, const DrawnFile& file, std::vector<WebLight>& lights);

}  // namespace OvTool
