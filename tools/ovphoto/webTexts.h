#pragma once

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "tools/ovphoto/hostSession.h"

// What people read of a web.

namespace OvTool {

/// "Full", "Half", "Quarter" or "Axial".
const char* symmetryName(Ov::PhotoWebSymmetry symmetry);

/// @{
/// The angles of a web in its own frame, degrees.
std::vector<double> thetasOf(const Ov::RnPhotoWebData& web);
std::vector<double> psisOf(const Ov::RnPhotoWebData& web);
/// @}
/// The files that it depends on.
std::vector<std::string> filesOf(const Ov::RnPhotoWebData& web);

/// What the values of the format's files are: "cd" or "cd/klm".
const char* unitName(Ov::PhotoValueUnit unit);

/// The peak in candela.
float peakCandela(Ov::RnPhotoWebData& web);
/// What the luminaire gives off of what its lamps do; none where the file does not say what these do.
std::optional<double> outputRatio(Ov::RnPhotoWebData& web);

/// Format, symmetry, angles as the file counts them, peak, flux, orientation: names and what they are.
std::vector<std::pair<std::string, std::string>> webTexts(const ReadResult& result);

}  // namespace OvTool
