#pragma once

#include "ovphoto/intensityDist.h"

namespace OvTool {

/// What a light differs from another that was made of it.
struct ConversionLoss {
    double candela = 0;         // the largest difference in the host frame
    double rimCandela = 0;      // that at rims of dark ranges, where it is larger and not in `candela`
    double candelaPercent = 0;  // of the first light's peak
    double fluxPercent = 0;     // of what the first light gives off, positive where the other gives more
};

/// Compares the candela of two lights, those of the source at the angles of its web and midway between them or,
/// without a web, every half degree from the axis; and what both give off in all, integrated alike. Light that ends at
/// a rim falls off within some steps on an even grid: then the rim counts by itself.
ConversionLoss measureLoss(Ov::RnIntensityDist& source, Ov::RnIntensityDist& output);

}  // namespace OvTool
