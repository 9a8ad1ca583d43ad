#pragma once

// Where the sun stands: the two-sine fits and the spherical triangle of the IES daylight model (IES RP-21,
// Recommended Practice for the Calculation of Daylight Availability, 1984).
//
// Units:    radians; decimal hours. Solar time runs from midnight, at 12 the sun is due south.
// Signs:    latitude and declination north positive; azimuth 0 = south, positive towards west.
// Accuracy: altitude within 1.2 degrees and equation of time within 1.2 minutes of the true ones, in any year;
//           most of it because the leap days are left out. solar_test measures it.

namespace OvPhotometrics {

/// Solar less mean time in hours, for a day of the year 1..365.
double equationOfTime(int day);

/// The sun's declination for a day of the year 1..365.
double solarDeclination(int day);

/// Sine and cosine of a latitude. From the poles on they are those of the pole, exactly, so that nothing rises or
/// sets there by a rounding error.
struct LatitudeTerms {
    explicit LatitudeTerms(double latitude);
    double sine;
    double cosine;
};

struct SolarPosition {
    double altitude;
    double azimuth;
};

SolarPosition solarPosition(const LatitudeTerms& latitude, double declination, double solarTime);

/// Solar time of sunrise, 0..12; the sun sets at 24 less it. A sun that stays up rises at 0, one that stays down
/// at 12. At a pole with the declination 0, on the days 81 and 265, it is 6.
double sunriseSolarTime(const LatitudeTerms& latitude, double declination);

}  // namespace OvPhotometrics
