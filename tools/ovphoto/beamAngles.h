#pragma once

#include <optional>
#include <vector>

#include "ovphoto/intensityDist.h"
#include "tools/plot/lightFrame.h"

namespace OvTool {

/// Beam and field angle in one plane through the light: the angle between the first directions on either side of
/// the plane's peak where the intensity has fallen to 50 % and to 10 % of it. Degrees; none when it does not fall
/// that far.
struct BeamAngles {
    const char* plane;  // "C0-C180"
    std::optional<OvPlot::AngleSpan> beam;
    std::optional<OvPlot::AngleSpan> field;
};

/// Where the light's axis and its two main planes lie in the frame of its web: C0-C180 and C90-C270 of the host
/// frame, which are those of the file; for a web that ends at its last horizontal angle (types A and B) the
/// horizontal and the vertical plane through the photometric axis.
OvPlot::LightFrame mainFrame(const Ov::RnPhotoWebData& web);

/// The angles of the light's two main planes, from its interpolated intensities.
std::vector<BeamAngles> beamAngles(const Ov::RnWebIntensityDist& light);

}  // namespace OvTool
