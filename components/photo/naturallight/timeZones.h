#pragma once

// The named time zones. Offsets and longitudes are positive towards west: the zone five hours behind Greenwich has
// offset 5 and the meridian 75 degrees. An index is valid from 0 to one below the count.

namespace OvPhotometrics {

int getTimeZoneCount();

/// The zone's name from the message catalogue; empty for an invalid index. The text stays valid as long as the
/// module is loaded.
/// Errors:   RnMessageFileEx when there is no catalogue.
/// Threads:  any number.
const wchar_t* getTimeZoneName(int index);

/// The zone's flag, 0 or 1: 1 marks the second of two zones of one offset. 0 for an invalid index.
int getTimeZoneFlag(int index);

/// The longitude of the zone's meridian in radians; 0 for an invalid index.
float getTimeZoneMeridian(int index);

/// The zone whose meridian (radians) is nearest, the first of equals; 0 for what is no number.
int findTimeZone(float meridian);

/// Whether the longitude (degrees, -180..180) lies within the range of longitudes of the zone, ends excluded.
/// False for an invalid index.
bool isInTimeZone(int index, float longitude);

}  // namespace OvPhotometrics
