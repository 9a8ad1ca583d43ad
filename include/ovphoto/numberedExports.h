#pragma once

#include <cstdint>

#include "host/componentManager/module.h"
#include "ovphoto/module.h"
#include "ovphoto/numberedExportList.h"

// Functions that the module exports by number alone, for a host's dialogs: calendar, clock and time zones. A host
// reaches them through Ov::Module::byOrdinal, which asks the system where modules have ordinals, and elsewhere reads the
// table at the end of this file.
//
// Offsets, meridians and longitudes are positive towards WEST. A year has 365 days, month 1 is January, day 1 is
// 1 January. An index of a time zone is valid from 0 to one below the count. Null pointers to results are skipped.
// Nothing throws, but the functions that give names do (RnMessageFileEx) when there is no catalogue of messages.
//
// Names are in the host's language; their texts are the module's, valid as long as it is loaded.
//
// Any number of threads may call any of the functions.

namespace OvPhotometrics {

/// The functions with their types.
struct NumberedFunctions {
    /// Decimal hours of a clock reading. Hours count modulo 24 or, with `twelveHour`, modulo 12 plus 12 when `pm`;
    /// remainders keep the sign. Minutes may be any number; 24 is taken off once when the sum reaches 24.
    float (*hoursMinutesToDecimal)(bool twelveHour, int hours, int minutes, bool pm);
    /// The clock reading nearest to any decimal hours, 0:00 where they are no number. With `twelveHour`, midnight
    /// and noon read 0, and `pm` is written; without, it is not.
    void (*decimalToHoursMinutes)(bool twelveHour, float decimalHours, int* hours, int* minutes, bool* pm);

    /// Empty for an invalid index.
    const wchar_t* (*getTimeZoneName)(int index);
    /// 1 for the second of two zones of one offset, else 0; 0 for an invalid index.
    int (*getTimeZoneFlag)(int index);
    /// Longitude of the zone's meridian in radians, 15 degrees for each hour; 0 for an invalid index.
    float (*getTimeZoneMeridian)(int index);
    /// How many zones there are.
    int (*getTimeZoneCount)();
    /// The index of the zone with the meridian (radians) nearest to this one, the lowest of equals.
    int (*findTimeZone)(float meridian);
    /// Whether the longitude (degrees, -180 to 180) lies inside the zone's range; false for an invalid index.
    bool (*isInTimeZone)(int index, float longitude);

    /// @{
    /// Empty outside 1..12.
    const wchar_t* (*getMonthName)(int month);
    const wchar_t* (*getMonthShortName)(int month);
    /// @}

    /// 0 outside 1..12.
    int (*getDaysInMonth)(int month);
    /// 1..365, or 0 when there is no such date.
    int (*dayOfYear)(int month, int day);
    /// The date of a day of the year; false, and nothing written, outside 1..365.
    bool (*monthAndDay)(int dayOfYear, int* month, int* day);
};

/// The functions of a loaded module (an Ov::Module); null where it has none.
template <class Module>
NumberedFunctions numberedFunctions(const Module& module) {
#define OVPHOTO_FIND_EXPORT(number, name) \
    .name = reinterpret_cast<decltype(NumberedFunctions::name)>(module.byOrdinal(number)),
    return {OVPHOTO_NUMBERED_EXPORTS(OVPHOTO_FIND_EXPORT)};
#undef OVPHOTO_FIND_EXPORT
}

}  // namespace OvPhotometrics

/// One entry of the table; the last has ordinal 0 and no function.
struct RnNumberedExport {
    std::uint32_t ordinal;  ///< its number
    void (*function)();     ///< to be cast to its own type
};

/// The table, the entry point under its number first. On Windows there is none: the module's own has the numbers.
extern "C" OVPHOTO_EXPORT const RnNumberedExport RnNumberedExports[];
