#include "tools/ovphoto/placeAndTime.h"

#include <algorithm>
#include <charconv>
#include <chrono>
#include <cmath>
#include <numbers>

#include "components/support/path.h"
#include "tools/ovphoto/language.h"

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

/// In either case of ASCII letters.
bool startsWith(std::string_view text, std::string_view start) {
    return text.size() >= start.size() && std::equal(start.begin(), start.end(), text.begin(),
                                                     [](char a, char b) { return upper(a) == upper(b); });
}

}  // namespace

std::optional<float> parseSide(std::string_view text, std::string_view sides) {
    const std::size_t side = text.empty() ? std::string_view::npos : sides.find(upper(text.back()));
    if (side == std::string_view::npos) return parseFloat(text);
    text.remove_suffix(1);
    const auto degrees = parseFloat(text);
    if (!degrees || text.front() == '-') return {};
    return side == 0 ? degrees : -*degrees;
}

std::optional<float> parseHours(std::string_view text) {
    const std::size_t colon = text.find(':');
    if (colon == std::string_view::npos) {
        const auto decimal = parseFloat(text);
        return decimal && *decimal >= 0 && *decimal <= 24 ? decimal : std::nullopt;
    }
    const auto hours = parseTwoDigits(text.substr(0, colon));
    const std::string_view rest = text.substr(colon + 1);
    const auto minutes = rest.size() == 2 ? parseTwoDigits(rest) : std::nullopt;
    if (!hours || !minutes || *minutes > 59 || 60 * *hours + *minutes > 24 * 60) return {};
    return static_cast<float>(*hours + *minutes / 60.0);
}

std::optional<Date> parseDate(std::string_view text) {
    namespace chrono = std::chrono;
    constexpr std::size_t yearDigits = 4;
    if (text.find_first_not_of("0123456789") == yearDigits) text.remove_prefix(yearDigits + 1);
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

std::optional<float> parseZoneHours(std::string_view text) {
    constexpr float furthest = 14;
    if (!startsWith(text, "UTC") && !startsWith(text, "GMT")) return parseFloat(text);
    text.remove_prefix(3);
    if (text.empty()) return 0.0F;
    if (text.front() != '+' && text.front() != '-') return {};
    const auto hours = parseHours(text.substr(1));
    if (!hours || *hours > furthest) return {};
    return text.front() == '-' ? hours : 0 - *hours;
}

float zoneHours(int index, const OvPhotometrics::NumberedFunctions& functions) {
    return static_cast<float>(std::round(functions.getTimeZoneMeridian(index) * 1200 / std::numbers::pi) / 100);
}

std::optional<float> findZoneHours(std::string_view name, const OvPhotometrics::NumberedFunctions& functions) {
    for (int i = 0; i < functions.getTimeZoneCount(); ++i) {
        const std::string zone = Ov::toUtf8(functions.getTimeZoneName(i));
        if (zone.size() == name.size() && startsWith(zone, name)) return zoneHours(i, functions);
    }
    return {};
}

std::string degreesText(const std::string& number) { return number + inLanguage(" deg", " Grad"); }

std::string latitudeText(float degrees) {
    return degreesText(shortNumber(std::abs(degrees))) + (degrees < 0 ? " S" : " N");
}

std::string longitudeText(float degrees) {
    return degreesText(shortNumber(std::abs(degrees))) + (degrees < 0 ? inLanguage(" E", " O") : " W");
}

const char* azimuthRule() {
    return inLanguage("0 is south, positive towards west", "0 ist Süden, nach Westen positiv");
}

const char* azimuthSentence() {
    return inLanguage("Azimuth 0 is south, positive towards west.", "Azimut 0 ist Süden, nach Westen positiv.");
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
