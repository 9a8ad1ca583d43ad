#pragma once

#include <optional>
#include <vector>

#include "ovphoto/intensityDist.h"

namespace OvTool {

/// Beam and field angle in one plane through the light: the angle between the first directions on either side of
/// the plane's peak where the intensity has fallen to 50 % and to 10 % of it. Degrees; none when it does not fall
/// that far.
struct BeamAngles {
    const char* plane;  // "C0-C180"
    std::optional<double> beam;
    std::optional<double> field;
};

/// The angles of the light's two main planes, from its interpolated intensities: C0-C180 and C90-C270 of the host
/// frame, which are those of the file; for a web that ends at its last horizontal angle (types A and B) the
/// horizontal and the vertical plane through the photometric axis.
std::vector<BeamAngles> beamAngles(const Ov::RnWebIntensityDist& light);

}  // namespace OvTool
