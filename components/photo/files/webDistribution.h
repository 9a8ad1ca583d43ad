#pragma once

#include "components/photo/lid/photoWeb.h"
#include "ovphoto/intensityDist.h"

namespace OvPhotometrics {

/// A new web distribution of the host's component manager that holds `web` and gives its flux, as every save
/// needs it. Raises ExBadCast when the host has no manager or knows no web distribution.
RnRef<Ov::RnWebIntensityDist> makeWebDistribution(Ov::RnPhotoWebData& web);

/// The web that a distribution holds; null when it is no web distribution or holds none.
RnRef<Ov::RnPhotoWebData> webOf(Ov::RnIntensityDist& distribution);

}  // namespace OvPhotometrics
