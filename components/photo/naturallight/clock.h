#pragma once

// Decimal hours and clock readings. On a clock of twelve hours, midnight and noon read 0.

namespace OvPhotometrics {

/// Decimal hours of a clock reading: hours are taken modulo 24 or, on a clock of twelve hours, modulo 12 plus 12
/// in the afternoon (`pm`); remainders keep the sign. Minutes may be any number; 24 is taken off once when the sum
/// reaches 24.
float hoursMinutesToDecimal(bool twelveHour, int hours, int minutes, bool pm);

/// The clock reading nearest to decimal hours of any size or sign; hours without a number read 0:00. `pm` is
/// written on a clock of twelve hours only. Null pointers are skipped.
void decimalToHoursMinutes(bool twelveHour, float decimalHours, int* hours, int* minutes, bool* pm);

}  // namespace OvPhotometrics
