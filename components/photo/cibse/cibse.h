#pragma once

#include <array>
#include <cstdint>
#include <string>

#include "components/photo/files/candelaGrid.h"
#include "components/photo/files/fileFacts.h"

// CIBSE TM14 photometric files.
//
//   line 1       "CIBSE/1"
//   lines 2-8    seven labels of free text, 60 characters each at most
//   numbers      lead integer, photometric type, three lead values, three factors, single value; vertical count,
//                horizontal count; vertical angles, horizontal angles, and the candelas of each horizontal angle;
//                trailer integer, three trailer values
//
// Units:    degrees and candela in the file, candela being value times the first factor; radians and values
//           relative to the peak in an installed web.
// Errors:   false, after reported messages (12935, 12936, 12943 to 12948, 12959 to 12962, 12964 to 12968, 12982 to
//           12991); only a host without its services raises, ExBadCast.
// Threads:  any number; each reading has its own state.
// More:     docs/formats/cibse.md

namespace OvPhotometrics {

class PhotoWebCIBSE;

/// How far an angle may lie from the value that it stands for, in degrees.
inline constexpr float cibseTolerance = 0.05f;
/// How many characters of a label are kept.
inline constexpr std::size_t cibseLabelLimit = 60;

/// Planes through the vertical axis, or through a horizontal one.
enum class CibsePhotometricType : std::int32_t { type1 = 1, type2 = 2 };

/// What a file starts with.
inline constexpr const wchar_t* cibseSignature = L"CIBSE/1";

/// A file as it was read, or as it is to be written. What has no comment is kept and written back, no more.
struct CibseRecord {
    std::array<std::wstring, 7> labels;  // lines 2 to 8; an empty line has none
    std::int32_t leadInteger = 1;        // at least 1
    CibsePhotometricType photometricType = CibsePhotometricType::type1;
    std::array<float, 3> leadValues{};
    std::array<float, 3> factors{1, 0, 0};  // the first multiplies every candela
    float singleValue = 0;
    CandelaGrid grid;
    std::int32_t trailerInteger = 99;
    std::array<float, 3> trailerValues{};
};

/// Reads a file from the stream's position up to the last trailer value. On failure the record is empty.
bool cibseRead(CibseRecord& rec, Ov::RnStream& in);

/// Checks the grid, chooses symmetry, shifts and orientation by photometric type, and installs the web. On failure
/// the web is as it was.
bool cibseToWeb(const CibseRecord& rec, PhotoWebCIBSE& web, bool loaded, const wchar_t* name);

/// A record to write for a distribution, scaled to 1000 lumens: its web's own grid with relative values where that
/// fits type 1 or 2, else its candelas sampled every 10 degrees.
bool cibseRecordFromDistribution(Ov::RnIntensityDist& dist, CibseRecord& rec);
/// The sampled record; candela times `scale`.
bool cibseResample(Ov::RnIntensityDist& dist, CibseRecord& rec, float scale);
/// A record to write as a file for other programs: with the first factor absolute candela, on the web's own grid
/// where type 1 or 2 can hold it with its orientation. Throws std::bad_alloc.
bool cibseRecordFromDistributionFaithfully(Ov::RnIntensityDist& dist, CibseRecord& rec);
/// Writes the record as text, labels cut at their 60 characters. True; a stream's failure raises.
bool cibseWrite(const CibseRecord& rec, Ov::RnStream& out, FileForm form);

/// Whether the input starts with "CIBSE/1". The position is kept.
bool cibseCanRead(Ov::RnBufferedIO& io);

/// What a file says beyond its web.
void cibseDescribe(const CibseRecord& rec, FileFacts& facts);
/// Labels and numbers for a record that is written for other programs: those of another CIBSE file, or `name` and
/// the other file's lines as labels.
void cibseCarry(const FileFacts& facts, const std::wstring& name, CibseRecord& rec);

}  // namespace OvPhotometrics
