#pragma once

#include <cstdint>

#include "host/componentManager/enumerator.h"
#include "host/componentManager/module.h"
#include "host/componentManager/stream.h"
#include "ovphoto/intensityDist.h"
#include "ovphoto/module.h"
#include "ovphoto/numberedExportList.h"

// Functions that the module exports by number alone: calendar, clock and time zones for a host's dialogs, files in
// any of the formats, and intensities towards many directions. A host reaches them through Ov::Module::byOrdinal,
// which asks the system where modules have ordinals, and elsewhere reads the table at the end of this file.
//
// Calendar, clock and zones (422 to 434).
//
// Offsets, meridians and longitudes are positive towards WEST. A year has 365 days, month 1 is January, day 1 is
// 1 January. An index of a time zone is valid from 0 to one below the count. Null pointers to results are skipped.
// Nothing throws, but the functions that give names do (RnMessageFileEx) when there is no catalogue of messages.
//
// Names are in the host's language; their texts are the module's, valid as long as it is loaded.
//
// Any number of threads may call any of the functions, each with streams, devices and visitors of its own.
//
// Files (435 to 438, 440 and 441) and intensities (439) are described where they stand below.

namespace OvPhotometrics {

/// What a distribution is written as.
enum class FileForm : std::int32_t {
    /// What a web of the format saves into a host's stream: IES and CIBSE with relative values, grids that do not
    /// fit sampled coarsely in the web's own frame, orientations dropped. Facts are not used.
    asSaved = 0,
    /// A file that is right in other programs: absolute candela (cd per 1000 lm in TBT) with six digits or more
    /// where the format has decimals. The grid is the web's own, orientation included, where the format can hold it;
    /// else the distribution in the host frame on even planes, with steps of the web's smallest, 1 degree at the
    /// least or finer for narrow beams, that lose less than 0.1 % of the peak where they can. What is written has
    /// been read back by the format's own reader.
    faithful = 1
};

/// One thing that a file says beyond its web. Keys of label lines:
///
///     IES      the header's keywords without brackets ("MANUFAC", "MORE"), "line" for other header lines
///     CIBSE    "label 1" to "label 7"
///     NIMB     "line 1" to "line 4"
///     TBT      "title"
///
/// and of numbers and choices:
///
///     IES      "format", "lamps", "lumensPerLamp", "multiplier", "ballastFactor", "ballastLampFactor", "watts",
///              "units" (feet, metres), "width", "length", "height", "photometricType" (C, B, A), "tilt" (NONE,
///              INCLUDE or a file name), "photometry" (absolute, relative)
///     CIBSE    "leadInteger", "photometricType", "leadValues", "factors", "singleValue", "trailerInteger",
///              "trailerValues"
///     NIMB     "identifier", "orientationAngle", "symmetryCode1", "symmetryCode2", "spare1" to "spare3"
///     TBT      "flux", "referenceFlux", "multiplier", "auxValue1" to "auxValue3", "symmetryCode", "kindCode",
///              "kindValue1", "kindValue2", "unitTriple"
///
/// and, last, where labels hold more than ASCII, "encoding": "UTF-8" or "Windows-1252". A label whose bytes are UTF-8
/// is that text, all others are Windows-1252. Labels are written in the encoding that the facts name, or in UTF-8.
///
/// Numbers are the shortest text that reads back as the same value, several with one blank between them.
struct FileFact {
    const wchar_t* key;   ///< which; as listed above
    const wchar_t* text;  ///< what the file says
};

/// How directions are given, and in which frame: as the operation of RnIntensityDist named beside takes them.
enum class DirectionForm : std::int32_t {
    angles = 0,            ///< `intensity`: theta and psi, radians, host frame
    vectors = 1,           ///< `intensityAt`: x, y and z of any length but 0, host frame
    unitVectors = 2,       ///< `intensityAtUnit`: x, y and z of length 1, host frame
    localAngles = 3,       ///< `localIntensity`: theta and psi, radians, the light's own frame
    localVectors = 4,      ///< `localIntensityAt`: x, y and z of any length but 0, the light's own frame
    localUnitVectors = 5,  ///< `localIntensityAtUnit`: x, y and z of length 1, the light's own frame
};

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

    /// @{
    /// Write any distribution as the text of a file to a text stream. A faithful file takes its label lines, and
    /// those of the format's own numbers that do not follow from the light, from `count` facts as `readFileFacts`
    /// gives them, of any format: lines of another format go where there is room, keywords in front; the name of a
    /// web distribution's web goes where no fact says what the luminaire is. A text that would make an importer take
    /// the file for one of another format is written behind a blank, after a message.
    /// False, and nothing has been written, after messages to the host's reporter; a stream that fails raises
    /// RnStreamEx. NIMB and TBT in the form that is saved raise ExBadCast for a web distribution without a web.
    bool (*writeIes)(Ov::RnIntensityDist& distribution, Ov::RnStream& out, FileForm form, const FileFact* facts,
                     std::int32_t count);
    bool (*writeCibse)(Ov::RnIntensityDist& distribution, Ov::RnStream& out, FileForm form, const FileFact* facts,
                       std::int32_t count);
    bool (*writeNimb)(Ov::RnIntensityDist& distribution, Ov::RnStream& out, FileForm form, const FileFact* facts,
                      std::int32_t count);
    bool (*writeTbt)(Ov::RnIntensityDist& distribution, Ov::RnStream& out, FileForm form, const FileFact* facts,
                     std::int32_t count);
    /// @}

    /// Intensities of any distribution towards `count` directions, for renderers: what its own operation answers
    /// to each, bit for bit, but faster where the distribution is a web of this module. `directions` holds two
    /// floats (angles) or three (vectors) for each, one direction after another; `candela` takes `count` floats
    /// and may not overlap them. Both may be null when `count` is 0. False, and nothing has been written, when
    /// `light` is null or no distribution, a pointer is null, the count is below 0 or the form is none of those
    /// above. A zero vector raises the assertion that the single operation raises; what has been written by then
    /// is not to be used. The wrappers in ovphoto/intensities.h take spans.
    bool (*getIntensities)(Ov::RnCastable* light, DirectionForm form, const float* directions, std::int64_t count,
                           float* candela);

    /// Reads an input and visits what it says beyond its web, label lines first, each in the order of the file.
    /// The format is that of the web class `format`, or, when that is null, of the first whose content test
    /// accepts the input. `basePath` (may be null) is where a tilt file is looked for first. The texts are valid
    /// during the visit. False, and nothing has been visited, when the input is refused (after messages) or of no
    /// known format.
    bool (*readFileFacts)(Ov::RnBufferedIO& io, const Ov::RnUid* format, const wchar_t* basePath,
                          Ov::RnEnumerator<const FileFact&>& visitor);

    /// Both in one reading: imports a web as the builder of the web class `format` does, which raises
    /// RnStreamEx::ExReadError where it refuses, and then visits what the file says beyond it. `name`, which
    /// becomes the web's, and `basePath` may be null. Null, and nothing has been read, where `format` is no web
    /// class.
    Ov::RnRef<Ov::RnCastable> (*importWithFacts)(Ov::RnBufferedIO& io, const Ov::RnUid& format,
                                                 const wchar_t* name, const wchar_t* basePath,
                                                 Ov::RnEnumerator<const FileFact&>& visitor);
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
