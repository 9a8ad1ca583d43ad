#pragma once

#include <cstdint>
#include <deque>
#include <string>
#include <vector>

#include "components/photo/files/candelaGrid.h"
#include "components/photo/files/fileFacts.h"

// IES LM-63 photometric files (1986, 1991, 1995 and 2002).
//
//   header     any number of lines, the first often "IESNA91" or "IESNA:LM-63-2002", kept as they stand
//   TILT=...   NONE, INCLUDE, or the name of a tilt file; with INCLUDE the tilt block follows
//   numbers    lamps, lumens per lamp, candela multiplier, vertical count, horizontal count, photometric type,
//              units type, width, length, height, ballast factor, ballast-lamp factor, input watts; vertical angles,
//              horizontal angles, and the candelas of each horizontal angle
//
// Units:    degrees and candela in the file, candela being value times multiplier and both ballast factors;
//           radians and values relative to the peak in an installed web.
// Errors:   false, after reported messages (12932 to 12968); only a host without its services raises, ExBadCast.
// Threads:  any number; each reading has its own state.
// More:     docs/formats/ies.md

namespace OvPhotometrics {

class PhotoWebIES;

/// How far an angle may lie from the value that it stands for, in degrees.
inline constexpr float iesTolerance = 0.25f;

enum class IesTiltKind : std::int32_t { none = 0, include = 1, file = 2 };

/// Intensity factors of a tilted luminaire: read and checked, but not applied.
struct IesTilt {
    std::int32_t geometry = 1;       // lamp to luminaire: 1, 2 or 3
    std::vector<float> tiltAngles;   // degrees, from 0 to 90 or 180
    std::vector<float> tiltFactors;  // one for each angle
};

enum class IesPhotometricType : std::int32_t { C = 1, B = 2, A = 3 };

/// A deque, because it grows without a copy: a file may hold nothing but line ends, and each is a line.
using IesLines = std::deque<std::wstring>;

/// A file as it was read, or as it is to be written.
struct IesFileRecord {
    IesLines lines;  // every line before the TILT= line
    std::int32_t lampCount = 1;
    float lumensPerLamp = -1;  // -1: absolute photometry
    float candelaMultiplier = 1;
    IesTiltKind tiltKind = IesTiltKind::none;
    std::wstring tiltFile;  // as written, for IesTiltKind::file
    IesTilt tilt;
    std::int32_t unitsType = 2;  // 1 feet, 2 metres
    float width = 0;
    float length = 0;
    float height = 0;
    float ballastFactor = 1;
    float ballastLampFactor = 1;  // the field that newer files keep for future use
    float inputWatts = 0;
    IesPhotometricType photometricType = IesPhotometricType::C;
    CandelaGrid grid;
};

/// Reads a file from the stream's position up to the last candela. `basePath` (may be null) is where a tilt file
/// is looked for first. On failure the record is empty.
bool iesReadRecord(IesFileRecord& rec, Ov::RnStream& in, const wchar_t* basePath);
/// Reads a tilt block.
bool iesReadTilt(IesTilt& tilt, Ov::RnStream& in);
/// The path of a tilt file, or empty: in `basePath`, then in the folders of "WebPathList".
std::wstring iesFindTiltFile(const std::wstring& name, const wchar_t* basePath);

/// Checks the grid, chooses symmetry, offsets and orientation by photometric type, and installs the web. On
/// failure the web is as it was.
bool iesRecordToWeb(const IesFileRecord& rec, PhotoWebIES& web, bool loaded, const wchar_t* name,
                    const wchar_t* basePath);

/// The defaults and the three header lines of what the library writes.
bool iesRecordInitForWriting(IesFileRecord& rec);
/// A record to write for a distribution: its web's own grid with relative values where that fits type C or A, else
/// its candelas sampled every 10 degrees. The flux stands as the lumens of one lamp.
bool iesRecordFromDistribution(Ov::RnIntensityDist& dist, IesFileRecord& rec);
bool iesRecordFromSampling(Ov::RnIntensityDist& dist, IesFileRecord& rec);
/// A record to write as a file for other programs: absolute candela, on the web's own grid where type C, A or B
/// can hold it with its orientation. Throws std::bad_alloc.
bool iesRecordFromDistributionFaithfully(Ov::RnIntensityDist& dist, IesFileRecord& rec);
/// What a file says beyond its web, and what of such facts a record to be written takes over: header lines, the
/// edition in the first of them, units, dimensions and watts. The name goes where nothing says which luminaire it is.
void iesDescribe(const IesFileRecord& rec, FileFacts& facts);
void iesCarry(const FileFacts& facts, const std::wstring& name, IesFileRecord& rec);
/// Writes the record as text; a record without a grid as the smallest one, dark. True; a stream's failure raises.
bool iesWriteRecord(const IesFileRecord& rec, Ov::RnStream& out, FileForm form);

/// Whether the input looks like an IES file: it starts with "IESNA91" or has a line that starts with "TILT=". The
/// position is kept.
bool iesCanRead(Ov::RnBufferedIO& io);

}  // namespace OvPhotometrics
