#pragma once

#include <functional>
#include <string>
#include <vector>

#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/naturalLight.h"

namespace OvTool {

/// Site, date, time and sky as the user gave them: a saved form to start from, and what to change in it.
struct DaylightOptions {
    using Change = std::function<void(Ov::RnNaturalLight&, const OvPhotometrics::NumberedFunctions&)>;

    std::string from;
    std::vector<Change> changes;
    std::vector<const CLI::Option*> site;  // those that name a place only together
};

/// Declares the options. `options` must outlive the parsing.
void addDaylightOptions(CLI::App& app, DaylightOptions& options);

/// An object with the options applied. Null when the saved form is refused; its reasons have been shown then. Half a
/// site and an unknown time zone raise CLI::ValidationError. Where no site is given, standard error tells which it is.
Ov::RnRef<Ov::RnNaturalLight> makeDaylight(const HostSession& session, const DaylightOptions& options, bool json);

/// Tells on standard error which settings are out of range, for commands that compute with them.
void showOutOfRange(const Ov::RnNaturalLight& naturalLight);

}  // namespace OvTool
