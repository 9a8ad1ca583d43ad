#pragma once

#include <string>
#include <vector>

#include "tools/ovphoto/fileFacts.h"

namespace OvTool {

/// What a user should know of a file that was read without a fault: negative candela, a web that is dark, tilt
/// data that is not applied, a type B file that stays unturned, planes that end early.
std::vector<std::string> webWarnings(const ReadResult& result);

}  // namespace OvTool
