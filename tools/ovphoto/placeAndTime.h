#pragma once

#include <array>
#include <optional>
#include <string>
#include <string_view>

#include "ovphoto/numberedExports.h"
#include "tools/numbers/numbers.h"

// Places and times between people and numbers. West and north are positive. Texts are in the user's language.

namespace OvTool {

/// The letters of the sides of the equator and of Greenwich, the positive one first. East may be "O", too.
inline constexpr std::string_view northSouth = "NS";
inline constexpr std::string_view westEast = "WEO";

/// "40.7", "-74", or with the letter of a side instead of a sign: "40.7N", "74w".
std::optional<float> parseSide(std::string_view text, std::string_view sides);

/// The hours of a day, 0 to 24, as "10.5" or as a clock reading: "10:30".
std::optional<float> parseHours(std::string_view text);

struct Date {
    int month;
    int day;
};

/// A date of a year without 29 February: "6-21", "06-21", or with a year, which changes nothing: "2026-06-21".
std::optional<Date> parseDate(std::string_view text);

/// A day number as settings can hold it: -32768 to 32767.
std::optional<int> parseDay(std::string_view text);

/// `count` numbers with commas between them.
template <std::size_t count>
std::optional<std::array<float, count>> parseList(std::string_view text) {
    std::array<float, count> values;
    for (std::size_t i = 0; i < count; ++i) {
        const std::size_t end = i + 1 < count ? text.find(',') : text.size();
        if (end == std::string_view::npos) return {};
        const auto value = parseFloat(text.substr(0, end));
        if (!value) return {};
        values[i] = *value;
        text.remove_prefix(i + 1 < count ? end + 1 : end);
    }
    return values;
}

/// A time zone in hours towards west. Signs are those of the form: a bare number counts as longitudes do ("5" is
/// New York, "-1" Berlin), behind UTC or GMT as clocks do ("UTC-5", "GMT+1", "UTC+5:30").
std::optional<float> parseZoneHours(std::string_view text);
/// The hours of the zone that `name` names in the list of the module, in either case of ASCII letters.
std::optional<float> findZoneHours(std::string_view name, const OvPhotometrics::NumberedFunctions& functions);
/// The hours of a zone of the list.
float zoneHours(int index, const OvPhotometrics::NumberedFunctions& functions);

/// @{
/// "41 deg N", "74 deg W".
std::string latitudeText(float degrees);
std::string longitudeText(float degrees);
/// @}
/// "12 deg".
std::string degreesText(const std::string& number);

/// @{
/// From where azimuths count, as part of a sentence and as a whole one.
const char* azimuthRule();
const char* azimuthSentence();
/// @}

/// What a clock of 24 hours shows: "9:05".
std::string clockText(const OvPhotometrics::NumberedFunctions& functions, float hours);
/// A time zone by its hours towards west: "UTC-5:00".
std::string utcText(const OvPhotometrics::NumberedFunctions& functions, float hoursWest);

}  // namespace OvTool
