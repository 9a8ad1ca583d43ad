#pragma once

#include <optional>
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

/// What became of a file that was to be converted.
struct ConversionReport {
    /// What the output does not hold of the source: facts, and the lumens of its lamps.
    struct Dropped {
        std::string key;
        std::string value;
    };
    /// What was lost, see ConversionLoss.
    struct Loss {
        float candela;
        float candelaPercent;
        float fluxPercent;
    };

    std::string file;  // as they were given
    std::string out;
    std::string format;        // of the file; empty where none was found
    std::string target;        // format of the output
    std::optional<Loss> loss;  // none where nothing was written or it cannot be read
    std::vector<Dropped> dropped;
    std::vector<std::string> warnings;
    bool ok = false;                    // whether the output was written
    std::vector<std::string> messages;  // what the reader and the writer reported, and why nothing was written
};

/// Converts a file and reads the result again before it is put in place.
ConversionReport convertFile(const Conversion& conversion, const HostSession& session);
/// The report on a file that was not converted.
ConversionReport unconverted(const Conversion& conversion, std::vector<std::string> reasons);

/// @{
/// A report as JSON, one member for each of its own and, for the loss, "maxCandelaDifference",
/// "maxCandelaDifferencePercent" and "fluxDifferencePercent"; what is not there is null. And back: none of JSON that is
/// no report.
Json toJson(const ConversionReport& report);
std::optional<ConversionReport> reportOf(const Json& json);
/// @}

/// Prints a report: as a line of JSON or, of a file that was converted, as a line of text. Messages and warnings
/// go to standard error, behind the file's name.
void printReport(const ConversionReport& report, bool json);

}  // namespace OvTool
