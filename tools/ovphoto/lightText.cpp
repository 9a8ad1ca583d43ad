#include "tools/ovphoto/lightText.h"

#include <charconv>
#include <chrono>
#include <cmath>

namespace OvTool {

namespace {

/// The whole text as a number of one or two digits.
std::optional<int> parseTwoDigits(std::string_view text) {
    int value = 0;
    if (text.empty() || text.size() > 2) return {};
    for (const char c : text) {
        if (c < '0' || c > '9') return {};
        value = 10 * value + (c - '0');
    }
    return value;
}

char upper(char c) { return c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c; }

}  // namespace

std::optional<float> parseSide(std::string_view text, char positive, char negative) {
    const char side = text.empty() ? '\0' : upper(text.back());
    if (side != positive && side != negative) return parseFloat(text);
    text.remove_suffix(1);
    const auto degrees = parseFloat(text);
    if (!degrees || text.front() == '-') return {};
    return side == positive ? degrees : -*degrees;
}

std::optional<float> parseHours(std::string_view text) {
    const std::size_t colon = text.find(':');
    if (colon == std::string_view::npos) return parseFloat(text);
    const auto hours = parseTwoDigits(text.substr(0, colon));
    const std::string_view rest = text.substr(colon + 1);
    const auto minutes = rest.size() == 2 ? parseTwoDigits(rest) : std::nullopt;
    if (!hours || !minutes || *minutes > 59 || 60 * *hours + *minutes > 24 * 60) return {};
    return static_cast<float>(*hours + *minutes / 60.0);
}

std::optional<Date> parseDate(std::string_view text) {
    namespace chrono = std::chrono;
    const std::size_t dash = text.find('-');
    if (dash == std::string_view::npos) return {};
    const auto month = parseTwoDigits(text.substr(0, dash));
    const auto day = parseTwoDigits(text.substr(dash + 1));
    if (!month || !day) return {};
    const chrono::month_day_last last{chrono::month_day_last(chrono::month(static_cast<unsigned>(*month)))};
    const chrono::year_month_day date(chrono::year(2001), last.month(), chrono::day(static_cast<unsigned>(*day)));
    if (!date.ok()) return {};
    return Date{*month, *day};
}

std::optional<int> parseDay(std::string_view text) {
    std::int16_t day;
    const char* end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, day);
    if (result.ec != std::errc() || result.ptr != end) return {};
    return day;
}

std::string sideText(float degrees, char positive, char negative) {
    return shortNumber(std::abs(degrees)) + " deg " + (degrees < 0 ? negative : positive);
}

std::string clockText(const OvPhotometrics::NumberedFunctions& functions, float hours) {
    int hour = 0;
    int minute = 0;
    functions.decimalToHoursMinutes(false, hours, &hour, &minute, nullptr);
    return std::to_string(hour) + (minute < 10 ? ":0" : ":") + std::to_string(minute);
}

std::string utcText(const OvPhotometrics::NumberedFunctions& functions, float hoursWest) {
    return (hoursWest > 0 ? "UTC-" : "UTC+") + clockText(functions, std::abs(hoursWest));
}

}  // namespace OvTool
