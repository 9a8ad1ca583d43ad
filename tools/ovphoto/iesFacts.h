#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace OvTool {

/// What an IES file says beyond the web that is made of it, for the warnings of `check`.
struct IesFacts {
    bool hasTilt = false;
    int photometricType = 0;  // 1 C, 2 B, 3 A
    float candelaMultiplier = 1;
    float ballastFactor = 1;
    float ballastLampFactor = 1;     // the future-use field
    float firstHorizontalAngle = 0;  // degrees
};

/// Reads the facts from the bytes of a file that the module has accepted; none when they are not where they are
/// expected.
std::optional<IesFacts> readIesFacts(std::string_view bytes);

}  // namespace OvTool
