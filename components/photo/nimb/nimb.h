#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "components/photo/files/fileFacts.h"
#include "components/photo/lid/photoWeb.h"
#include "host/componentManager/stream.h"
#include "ovphoto/intensityDist.h"

// NIMB: a fixed-column text form of a photometric web.
//
//   line 1     numbers in four-character fields; characters 36 to 39 read "NIMB"
//   lines 2-5  four lines of free text, 72 characters kept of each
//   lines 6-   candela values, 17 to a line: vertical angle 0 first, every horizontal angle of it
//
// Units:    whole degrees and candela of a lamp of 1000 lumens in the file; radians and values relative to the
//           peak in an installed web.
// Errors:   false, after a reported message (12970 to 12981, 12935, 12936); only the bad cast of a distribution's
//           web raises.
// Threads:  any number; each reading counts its own lines.
// More:     docs/formats/nimb.md

namespace OvPhotometrics {

/// Characters kept of a line.
inline constexpr int nimbLineLength = 72;
/// Candela values in a line; the last may have fewer.
inline constexpr int nimbValuesPerLine = 17;

/// A file as it was read, or as it is to be written. The numbers are those of its header.
struct NimbRecord {
    std::int32_t identifier = 0;         // up to eight digits
    std::int32_t psiMax = 0;             // last horizontal angle, degrees: 0, 90, 180 or 360 - psiStep
    std::int32_t thetaMax = 90;          // last vertical angle, degrees: 90 to 180
    std::int32_t psiStep = 90;           // degrees, a divisor of 90
    std::int32_t thetaStep = 90;         // degrees, a divisor of 90
    std::int32_t orientationAngle = 90;  // degrees; the web is turned by 90 less this
    std::int32_t symmetryCode1 = -1;     // a PhotoWebSymmetry, or -1: absent
    std::int32_t symmetryCode2 = -1;
    std::int32_t spare1 = 0;  // kept, never interpreted
    std::int32_t spare2 = 0;
    std::int32_t spare3 = 0;
    std::array<std::wstring, 4> lines = {};
    /// Candela; that of vertical index j and horizontal index i is element j * psiCount + i.
    std::vector<std::int16_t> values = {};

    int psiCount() const { return psiMax / psiStep + 1; }
    int thetaCount() const { return thetaMax / thetaStep + 1; }
    int valueCount() const { return psiCount() * thetaCount(); }

    bool operator==(const NimbRecord&) const = default;
};

/// @{
/// The largest numbers that the header's fields hold, and whether they hold one.
inline constexpr int nimbLargestField = 9999;
inline constexpr int nimbLargestIdentifier = 99999999;

inline bool nimbFitsField(std::int32_t number) { return number >= -999 && number <= nimbLargestField; }
inline bool nimbFitsIdentifier(std::int32_t number) { return number >= -999 && number <= nimbLargestIdentifier; }
/// @}

/// Whether the input looks like a NIMB file: it has 72 bytes, and "NIMB" in its place. The position is kept.
bool nimbCanRead(Ov::RnBufferedIO& io);

/// Reads a line into a buffer of 73 characters. The length kept, 0 to 72, or -1 at the end of the input.
int nimbReadLine(wchar_t* buffer73, Ov::RnStream& s);
/// Reads a file from the stream's position up to the last value. On failure the record is empty.
bool nimbRead(NimbRecord& rec, Ov::RnStream& s);
/// Installs the web. On failure it is as it was.
bool nimbToWeb(const NimbRecord& rec, RnBasePhotoWebData& web, bool loaded, const wchar_t* name);

/// A record to write for a distribution: candela per 1000 lumens in the host frame, mostly every degree by 5
/// degrees. Without a flux every value is 0.
bool nimbRecordFromDistribution(Ov::RnIntensityDist& dist, NimbRecord& rec);
/// A record to write as a file for other programs: candela, on the web's own grid where the format can hold it with
/// its orientation, else with steps as fine as the light wants. Throws std::bad_alloc.
bool nimbRecordFromDistributionFaithfully(Ov::RnIntensityDist& dist, NimbRecord& rec);
/// Writes the record as text. Header fields must fit their four characters.
bool nimbWrite(const NimbRecord& rec, Ov::RnStream& s);

/// The text lines and the numbers that no web holds.
void nimbDescribe(const NimbRecord& rec, FileFacts& facts);
/// Takes over what another file said: its text lines, or lines made of its label lines and `name`, and those
/// numbers that fit.
void nimbCarry(const FileFacts& facts, const std::wstring& name, NimbRecord& rec);

}  // namespace OvPhotometrics
