#pragma once

#include <array>
#include <cstdint>
#include <string>
#include <vector>

#include "components/photo/files/fileFacts.h"
#include "components/photo/lid/photoWeb.h"
#include "host/componentManager/stream.h"
#include "ovphoto/intensityDist.h"
#include "ovphoto/photoFormat.h"

// TBT: photometric webs of the QRT kind.
//
//   title      the first line that is neither blank nor a comment
//   kind       code 3 to 6, then no value (3), one (4, 6) or two (5)
//   triple     three numbers from 0 to 1
//   scalars    flux, reference flux, multiplier and three numbers that are kept
//   grid       symmetry code, vertical count, horizontal count
//   values     one row of vertical angles for each horizontal angle; "Z0" fills the rest of its row with zeros
//   end        -1
//
// Below the title, lines mean nothing: numbers without a sign stand between white space and /* comments */.
//
// Units:    candela per reference flux in the file (written by the library: per 1000 lumens), on even angles that
//           the file does not give; the same values, relative to their peak, and radians in an installed web.
// Errors:   false, after a reported message (12993 to 13025, 12935, 12936); only the bad cast of a distribution's
//           web raises.
// Threads:  any number; each reading has its own state.
// More:     docs/formats/tbt.md

namespace OvPhotometrics {

/// Characters kept of the title.
inline constexpr std::size_t tbtTitleLength = 80;
/// The most values that a grid may have.
inline constexpr std::int64_t tbtMostValues = 1 << 20;

/// A file as it was read, or as it is to be written.
struct TbtFileRecord {
    std::wstring title = {};
    float flux = 0;  // lumens
    float referenceFlux = 1000;
    float multiplier = 0;  // what the values are multiplied by for candela, where the library writes it
    float auxValue1 = 1;   // kept, never interpreted
    float auxValue2 = 5;
    float auxValue3 = 0;
    std::int32_t symmetryCode = 4;     // 1 axial, 2 quarter, 3 half, 4 full circle
    std::int32_t verticalCount = 0;    // evenly from 0 to 180 degrees
    std::int32_t horizontalCount = 0;  // evenly from 0 to 90, 180 or 360 degrees; 1 for symmetry code 1
    std::vector<float> values;         // vertical index v, horizontal index h: element h * verticalCount + v
    std::int32_t kindCode = 3;         // 3 to 6
    float kindValue1 = 0;              // codes 4, 5 and 6
    float kindValue2 = 0;              // code 5
    std::array<float, 3> unitTriple = {1, 1, 1};  // each from 0 to 1
};

/// How many values follow a kind code, or -1 for what is no kind code.
constexpr int tbtKindValues(std::int32_t kindCode) {
    return kindCode == 3 ? 0 : kindCode == 4 || kindCode == 6 ? 1 : kindCode == 5 ? 2 : -1;
}

/// Whether the first token behind the title is a kind code. The position is kept.
bool tbtCanRead(Ov::RnBufferedIO& io);
/// Reads a file from the stream's position up to the end marker. On failure the record has no values.
bool tbtRead(TbtFileRecord& rec, Ov::RnStream& in);
/// Installs the web, its values as they stand in the file. On failure it is as it was.
bool tbtToWeb(const TbtFileRecord& rec, RnBasePhotoWebData& web, bool loaded, const wchar_t* name);

/// The defaults and the title of what the library writes. Throws std::bad_alloc.
void tbtRecordInit(TbtFileRecord& rec);
/// A record to write for a distribution: candela per 1000 lumens in the host frame, on an even grid with the
/// smallest steps of its web, at most 90 by 180 angles. Without a flux every value is 0.
bool tbtRecordFromDistribution(Ov::RnIntensityDist& dist, TbtFileRecord& rec);
/// A record to write as a file for other programs: on the web's own grid where the format can hold it, else with
/// steps as fine as the light wants. Throws std::bad_alloc.
bool tbtRecordFromDistributionFaithfully(Ov::RnIntensityDist& dist, TbtFileRecord& rec);
/// Gives a record another flux and reference flux, and its values the unit that follows: the candela stay. Without
/// a flux (0) values are candela.
void tbtSetFlux(TbtFileRecord& rec, float flux, float referenceFlux);
/// Writes the record, whose values must be as many as its counts say, as text. True; a stream's failure raises.
bool tbtWrite(const TbtFileRecord& rec, Ov::RnStream& out, FileForm form);

/// The title and the numbers that no web holds.
void tbtDescribe(const TbtFileRecord& rec, FileFacts& facts);
/// Takes over what another file said: its title, or another label line or `name` instead, and those numbers that
/// the reader accepts, a multiplier of its own among them.
void tbtCarry(const FileFacts& facts, const std::wstring& name, TbtFileRecord& rec);

}  // namespace OvPhotometrics
