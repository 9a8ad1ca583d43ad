#pragma once

#include <optional>
#include <vector>

#include "ovphoto/intensityDist.h"
#include "plot/luminaireFrame.h"

namespace OvTool {

/// Beam and field angle in one plane through the light: the angle between the first directions on either side of
/// the plane's peak where the intensity has fallen to 50 % and to 10 % of it. Degrees; none when it does not fall
/// that far.
struct BeamAngles {
    const char* plane;  // "C0-C180"
    std::optional<OvPlot::AngleSpan> beam;
    std::optional<OvPlot::AngleSpan> field;
};

/// Where the light's axis and its two main planes lie in the frame of its web, by the angles of its file: C0-C180 and
/// C90-C270 are the planes of horizontal 0 and 90 degrees; where planes go through a horizontal axis (types A and B)
/// they are those of vertical 0 and of horizontal 0 through the axis of the light.
OvPlot::LuminaireFrame mainFrame(Ov::RnPhotoWebData& web);

/// The angles of the light's two main planes, from its interpolated intensities.
std::vector<BeamAngles> beamAngles(const Ov::RnWebIntensityDist& light);

}  // namespace OvTool
