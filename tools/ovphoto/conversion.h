#pragma once

#include <string>
#include <vector>

#include "tools/ovphoto/hostSession.h"
#include "tools/ovphoto/json.h"

namespace OvTool {

struct Conversion {
    std::string in;
    std::string out;
    std::string as;  // format to read as; empty: told by content
    const Format* target = nullptr;
    bool asSaved = false;
    bool brief = false;  // messages are for people: see ReadResult::told
};

/// Converts a file and reads the result again before it is put in place. The report has the members
///
///     file, out          as they were given
///     format, target     names of the formats; `format` is null where none was found
///     maxCandelaDifference, maxCandelaDifferencePercent, fluxDifferencePercent
///                        what was lost, see ConversionLoss; null where nothing was written or it cannot be read
///     dropped            array of {"key", "value"}: facts that the output does not hold, and "lampLumens"
///     warnings           array of texts
///     ok                 whether the output was written
///     messages           array of texts: what the reader and the writer reported, and why nothing was written
Json convertFile(const Conversion& conversion, const HostSession& session);
/// The report on a file that was not converted.
Json unconverted(const Conversion& conversion, const std::vector<std::string>& reasons);

/// Prints a report: as a line of JSON or, of a file that was converted, as a line of text. Messages and warnings
/// go to standard error, behind the file's name.
void printReport(const Json& report, const Conversion& conversion, bool json);

}  // namespace OvTool
