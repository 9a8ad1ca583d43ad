#pragma once

// Months and days. Every year has 365 days; there is no 29 February. Days of the year count from 1 = 1 January.

namespace OvPhotometrics {

constexpr int monthsInYear = 12;
constexpr int daysInYear = 365;

/// The month's length; 0 outside 1..12.
int getDaysInMonth(int month);

/// The day of the year, or 0 when there is no such date.
int dayOfYear(int month, int day);

/// The date of a day of the year. Outside 1..365 it answers false and writes nothing. Null pointers are skipped.
bool monthAndDay(int yearDay, int* month, int* day);

/// The month's name from the message catalogue; empty outside 1..12. The text stays valid as long as the module is
/// loaded.
///
/// Errors:   RnMessageFileEx when there is no catalogue.
/// Threads:  any number.
const wchar_t* getMonthName(int month);
const wchar_t* getMonthShortName(int month);

}  // namespace OvPhotometrics
