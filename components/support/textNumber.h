#pragma once

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <string_view>

// Decimal numbers in text, correctly rounded, whatever the locale.

namespace Ov {

/// Whether a decimal number that is out of its type's range is too large, not too small.
inline bool isTooLarge(std::string_view number) {
    const std::size_t e = std::min(number.find_first_of("eE"), number.size());
    const std::string_view digits = number.substr(0, e);
    const std::size_t point = std::min(digits.find('.'), digits.size());
    const std::size_t first = digits.find_first_of("123456789");
    if (first == std::string_view::npos) return false;
    std::string_view power = number.substr(std::min(e + 1, number.size()));
    if (power.starts_with('+')) power.remove_prefix(1);
    std::int64_t exponent = 0;
    if (std::from_chars(power.data(), power.data() + power.size(), exponent).ec ==
        std::errc::result_out_of_range) {
        return !power.starts_with('-');
    }
    return exponent > static_cast<std::int64_t>(first) - static_cast<std::int64_t>(point);
}

/// Converts a complete number; false when the type cannot hold it. What is too small is 0.
template <class T>
bool convertReal(std::string_view token, T& value) {
    const auto error = std::from_chars(token.data(), token.data() + token.size(), value).ec;
    if (error == std::errc{}) return std::isfinite(value);
    if (error != std::errc::result_out_of_range || isTooLarge(token)) return false;
    value = token.starts_with('-') ? -T(0) : T(0);
    return true;
}

}  // namespace Ov
