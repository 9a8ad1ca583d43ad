#include "tools/numbers/numbers.h"

#include <algorithm>
#include <charconv>
#include <cmath>
#include <numbers>

namespace OvTool {

namespace {

std::string formatDouble(double value, std::chars_format format, int precision) {
    char text[400];  // the largest double has 309 digits before its point
    const auto result = std::to_chars(std::begin(text), std::end(text), value, format, precision);
    return {text, result.ptr};
}

void dropTrailingZeros(std::string& text) {
    if (text.find('.') == std::string::npos) return;
    while (text.back() == '0') text.pop_back();
    if (text.back() == '.') text.pop_back();
}

}  // namespace

float toRadians(float degrees) { return static_cast<float>(degrees * std::numbers::pi / 180); }

double toDegrees(float radians) {
    const double degrees = static_cast<double>(radians) * 180 / std::numbers::pi;
    if (!std::isfinite(degrees)) return degrees;
    const auto exact = [&](double candidate) {
        return static_cast<float>(candidate * std::numbers::pi / 180) == radians;
    };
    const auto asRead = [&](double candidate) { return toRadians(static_cast<float>(candidate)) == radians; };
    const auto shortest = [&](auto fits) -> std::optional<double> {
        for (int digits = 1; digits <= 9; ++digits) {
            const std::string text = formatDouble(degrees, std::chars_format::general, digits);
            double candidate = 0;
            std::from_chars(text.data(), text.data() + text.size(), candidate);
            if (fits(candidate)) return candidate;
        }
        return {};
    };
    auto found = shortest([&](double candidate) { return asRead(candidate) && exact(candidate); });
    if (!found) found = shortest(asRead);
    if (!found) found = shortest(exact);
    return found.value_or(degrees);
}

double shortestNear(double value, const std::function<bool(float)>& fits) {
    for (int decimals = 0; decimals <= 9; ++decimals) {
        const std::string text = fixedNumber(value, decimals);
        double candidate = 0;
        std::from_chars(text.data(), text.data() + text.size(), candidate);
        if (fits(static_cast<float>(candidate))) return candidate;
    }
    return value;
}

std::optional<float> parseFloat(std::string_view text) {
    float value;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), value);
    if (error != std::errc() || end != text.data() + text.size() || !std::isfinite(value)) return {};
    return value;
}

std::string shortNumber(double value) {
    const double size = std::abs(value);
    if (!(size < 1e9) || (size > 0 && size < 1e-4)) return formatDouble(value, std::chars_format::general, 5);
    const int before = size >= 1 ? static_cast<int>(std::log10(size)) + 1 : 0;
    std::string text = formatDouble(value, std::chars_format::fixed, std::clamp(5 - before, 0, 5));
    dropTrailingZeros(text);
    return text;
}

std::string fixedNumber(double value, int decimals) {
    std::string text = formatDouble(value, std::chars_format::fixed, decimals);
    if (text.front() == '-' && text.find_first_of("123456789in") == std::string::npos) text.erase(0, 1);
    return text;
}

std::string exactNumber(float value) {
    char text[64];
    return {text, std::to_chars(std::begin(text), std::end(text), value).ptr};
}

std::size_t characterCount(std::string_view text) {
    return static_cast<std::size_t>(
        std::count_if(text.begin(), text.end(), [](char c) { return (c & 0xC0) != 0x80; }));
}

std::string padLeft(const std::string& text, std::size_t width) {
    const std::size_t count = characterCount(text);
    return count < width ? std::string(width - count, ' ') + text : text;
}

}  // namespace OvTool
