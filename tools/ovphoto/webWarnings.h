#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tools/ovphoto/fileFacts.h"

namespace OvTool {

/// What a user should know of a file that was read without a fault: negative candela or flux, a web that is dark, tilt
/// data that is not applied, a type B file that stays unturned, planes that end early.
std::vector<std::string> webWarnings(const ReadResult& result);

/// The warning of a type B file that stays unturned and becomes a file of another type, which holds `output`.
std::optional<std::string> lostTypeB(const ReadResult& source, const std::vector<Fact>& output);

/// The warning of a flux that is integrated and comes out below 0.
std::optional<std::string> negativeFlux(Ov::RnPhotoWebData& web);

}  // namespace OvTool
