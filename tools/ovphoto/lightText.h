#pragma once

#include <array>
#include <optional>
#include <string>
#include <string_view>

#include "ovphoto/numberedExports.h"
#include "tools/ovphoto/numbers.h"

// Places and times between people and numbers. West and north are positive.

namespace OvTool {

/// "40.7", "-74", or with the letter of a side instead of a sign: "40.7N", "74w".
std::optional<float> parseSide(std::string_view text, char positive, char negative);

/// Hours as "10.5" or as a clock reading up to 24:00: "10:30".
std::optional<float> parseHours(std::string_view text);

struct Date {
    int month;
    int day;
};

/// "6-21" or "06-21", a date of a year without 29 February.
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

/// "41 deg N", "74 deg W".
std::string sideText(float degrees, char positive, char negative);

/// What a clock of 24 hours shows: "9:05".
std::string clockText(const OvPhotometrics::NumberedFunctions& functions, float hours);
/// A time zone by its hours towards west: "UTC-5:00".
std::string utcText(const OvPhotometrics::NumberedFunctions& functions, float hoursWest);

}  // namespace OvTool
