#include <CLI/CLI.hpp>
#include <memory>

#include "components/support/path.h"
#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/naturalLight.h"
#include "tools/ovphoto/placeAndTime.h"
#include "tools/ovphoto/table.h"

namespace OvTool {

namespace {

int listZones(const HostSession& session, bool json) {
    const auto functions = session.functions();
    Table table;
    table.add({inLanguage("index", "Nummer"), inLanguage("offset", "Abstand"), inLanguage("meridian", "Meridian"),
               inLanguage("name", "Name")});
    for (int i = 0; i < functions.getTimeZoneCount(); ++i) {
        const std::string name = Ov::toUtf8(functions.getTimeZoneName(i));
        const float meridian = functions.getTimeZoneMeridian(i);
        const float hours = zoneHours(i, functions);
        if (json) {
            printLine(Json{{"index", i},
                           {"name", name},
                           {"offset", hours},
                           {"meridian", meridian},
                           {"flag", functions.getTimeZoneFlag(i)}});
        } else {
            table.add({padLeft(std::to_string(i), 5), utcText(functions, hours), longitudeText(15 * hours), name});
        }
    }
    if (!json) table.print();
    return exitWell;
}

int listMonths(const HostSession& session, bool json) {
    const auto functions = session.functions();
    Table table;
    table.add({inLanguage("month", "Monat"), inLanguage("name", "Name"), inLanguage("short", "kurz"),
               inLanguage("days", "Tage"), inLanguage("first day", "erster Tag")});
    for (int month = 1; functions.getDaysInMonth(month) > 0; ++month) {
        const std::string name = Ov::toUtf8(functions.getMonthName(month));
        const std::string shortName = Ov::toUtf8(functions.getMonthShortName(month));
        const int days = functions.getDaysInMonth(month);
        const int firstDay = functions.dayOfYear(month, 1);
        if (json) {
            printLine(Json{{"month", month},
                           {"name", name},
                           {"shortName", shortName},
                           {"days", days},
                           {"firstDay", firstDay}});
        } else {
            table.add({padLeft(std::to_string(month), 5), name, shortName, padLeft(std::to_string(days), 4),
                       padLeft(std::to_string(firstDay), 9)});
        }
    }
    if (!json) table.print();
    return exitWell;
}

Action declareList(CLI::App& app, int (*list)(const HostSession&, bool)) {
    auto json = std::make_shared<bool>(false);
    addJsonFlag(app, *json);
    return [json, list](const HostSession& session) { return list(session, *json); };
}

}  // namespace

Action declareZones(CLI::App& app) { return declareList(app, listZones); }

Action declareMonths(CLI::App& app) { return declareList(app, listMonths); }

}  // namespace OvTool
