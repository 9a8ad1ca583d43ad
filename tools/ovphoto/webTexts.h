#pragma once

#include <string>
#include <utility>
#include <vector>

#include "tools/ovphoto/hostSession.h"

// What people read of a web.

namespace OvTool {

/// "Full", "Half", "Quarter" or "Axial".
const char* symmetryName(Ov::PhotoWebSymmetry symmetry);

/// @{
/// The angles of a web, degrees.
std::vector<double> thetasOf(const Ov::RnPhotoWebData& web);
std::vector<double> psisOf(const Ov::RnPhotoWebData& web);
/// @}
/// The files that it depends on.
std::vector<std::string> filesOf(const Ov::RnPhotoWebData& web);

/// What the values of a file are, "cd" or "cd/klm"; webs hold them as they stand there.
const char* unitOf(const ReadResult& result);

/// Format, symmetry, angles, peak, flux, orientation: names and what they are.
std::vector<std::pair<std::string, std::string>> webTexts(const ReadResult& result);

}  // namespace OvTool
