#pragma once

#include <vector>

#include "ovphoto/photoFile.h"

// The angles and lumens of a web as its file has them.

namespace OvTool {

/// Of a web of another module: a file whose angles are the web's own.
Ov::PhotoFileInfo fileInfoOf(Ov::RnPhotoWebData& web);

/// The integral of the web's candela; `getLumens` of a web of another module.
float luminaireLumensOf(Ov::RnPhotoWebData& web);

/// @{
/// The angle of the file that a radian of the web's frame stands for, degrees with the fewest digits.
double verticalOf(const Ov::PhotoFileInfo& file, float theta);
double horizontalOf(const Ov::PhotoFileInfo& file, float psi);
/// @}

/// @{
/// The file's lists in degrees, with the plane that closes the circle.
std::vector<double> verticalsOf(Ov::RnPhotoWebData& web);
std::vector<double> horizontalsOf(Ov::RnPhotoWebData& web);
/// @}

}  // namespace OvTool
