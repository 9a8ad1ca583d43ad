#pragma once

#include "components/photo/lid/photoWeb.h"

namespace OvPhotometrics {

/// @{
/// The module's setting that ovphoto/saveForm.h describes.
bool websAreSavedFaithfully();
void saveWebsFaithfully(bool faithful);
/// @}

/// Whether `again`, read from what `web` was saved as, gives the same light: within 1e-5 of the peak in every
/// direction, and lumens as close. Every angle is the same then.
bool keepsLight(const RnBasePhotoWebData& web, const RnBasePhotoWebData& again);

}  // namespace OvPhotometrics
