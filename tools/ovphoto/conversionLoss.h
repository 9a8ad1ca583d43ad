#pragma once

#include "ovphoto/intensityDist.h"

namespace OvTool {

/// What a light differs from another that was made of it.
struct ConversionLoss {
    double candela = 0;         // the largest difference in the host frame
    double candelaPercent = 0;  // of the first light's peak
    double fluxPercent = 0;     // of the first light's flux, positive where the other gives more
};

/// Compares over the grid of the source's web or, without one, every half degree from the axis. Both give true
/// candela and flux.
ConversionLoss measureLoss(Ov::RnIntensityDist& source, const Ov::RnIntensityDist& output);

}  // namespace OvTool
