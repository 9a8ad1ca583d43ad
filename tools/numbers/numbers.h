#pragma once

#include <functional>
#include <optional>
#include <string>
#include <string_view>

// Numbers between people and floats. None of this depends on the locale.

namespace OvTool {

/// The angle as files' readers convert it: float of degrees times pi / 180 in double.
float toRadians(float degrees);
/// The degrees with the fewest digits, 9 at most, that give this angle back (30, not 30.000002): as a float, in
/// double, or both where that can be.
double toDegrees(float radians);

/// The number nearest to `value` with the fewest decimals, 9 at most, whose float `fits`; `value` where none does.
double shortestNear(double value, const std::function<bool(float)>& fits);

/// A finite decimal number that fits a float and is the whole text.
std::optional<float> parseFloat(std::string_view text);

/// For people: about five significant digits, without trailing zeros.
std::string shortNumber(double value);
/// With `decimals` digits behind the point, for columns; never "-0".
std::string fixedNumber(double value, int decimals);
/// As many digits as the float needs to read back the same.
std::string exactNumber(float value);

/// The characters of an UTF-8 text.
std::size_t characterCount(std::string_view text);
/// The text right-aligned in a field of `width` characters.
std::string padLeft(const std::string& text, std::size_t width);

}  // namespace OvTool
