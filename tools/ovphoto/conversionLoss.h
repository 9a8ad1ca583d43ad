#pragma once

#include "ovphoto/intensityDist.h"

namespace OvTool {

/// What every conversion loses at most, of the peak, where steps of a degree can keep it.
constexpr double keptPercent = 0.1;

/// What a light differs from another that was made of it.
struct ConversionLoss {
    double candela = 0;     // the largest difference in the host frame
    double rimCandela = 0;  // that at rims of dark ranges and at poles whose planes disagree, if not in `candela`
    double candelaPercent = 0;  // of the first light's peak
    double fluxPercent = 0;     // of what the first light gives off, positive where the other gives more
};

/// Compares the candela of two lights at the angles of both webs and between them or, where the source has none,
/// every half degree from the axis; and what both give off in all, integrated alike. Light that ends at a rim falls off
/// within some steps on an even grid: then the rim counts by itself.
ConversionLoss measureLoss(Ov::RnIntensityDist& source, Ov::RnIntensityDist& output);

}  // namespace OvTool
