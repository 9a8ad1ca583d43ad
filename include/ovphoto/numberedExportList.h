#pragma once

// Also read by the preprocessor alone, which makes the export definitions of a Windows module: nothing but macros.

// clang-format off

/// The list of them, number and name: tables and definition files are made from it.
#define OVPHOTO_NUMBERED_EXPORTS(entry) \
    entry(422, hoursMinutesToDecimal) \
    entry(423, decimalToHoursMinutes) \
    entry(424, getTimeZoneName) \
    entry(425, getTimeZoneFlag) \
    entry(426, getTimeZoneMeridian) \
    entry(427, getTimeZoneCount) \
    entry(428, findTimeZone) \
    entry(429, isInTimeZone) \
    entry(430, getMonthName) \
    entry(431, getMonthShortName) \
    entry(432, getDaysInMonth) \
    entry(433, dayOfYear) \
    entry(434, monthAndDay)

// clang-format on
