#include <CLI/CLI.hpp>
#include <iostream>
#include <memory>
#include <numbers>

#include "host/platform/path.h"
#include "tools/ovphoto/commands/lightOptions.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/lightText.h"
#include "tools/ovphoto/table.h"

namespace OvTool {

using namespace Ov;
using OvPhotometrics::NumberedFunctions;

namespace {

struct SunOptions {
    LightOptions light;
    bool dayTable = false;
    bool yearTable = false;
    bool json = false;
};

constexpr int hoursInDay = 24;
constexpr int monthsInYear = 12;
constexpr int yearTableDay = 21;  // of each month: about the solstices and equinoxes
constexpr const char* azimuthNote = "Azimuth 0 is south, positive towards west.";

/// Every derived value, as the interface gives it.
Json sunJson(RnNaturalLight& light) {
    const float solarTime = light.getSolarTime();  // first: where it was given, the local time follows from it
    return Json{{"localTime", light.getLocalTime()},
                {"solarTime", solarTime},
                {"equationOfTime", light.getEquationOfTime()},
                {"sunrise", light.getSunrise()},
                {"sunset", light.getSunset()},
                {"solarNoon", light.getSolarNoon()},
                {"sunriseSolarTime", light.getSunriseSolarTime()},
                {"sunsetSolarTime", light.getSunsetSolarTime()},
                {"solarAltitude", light.getSolarAltitude()},
                {"solarAzimuth", light.getSolarAzimuth()},
                {"solarZenith", light.getSolarZenith()},
                {"sunDirection", light.getSunDirection()},
                {"directNormalIlluminance", light.getDirectNormalIlluminance()},
                {"directHorizontalIlluminance", light.getDirectHorizontalIlluminance()},
                {"skyHorizontalIlluminance", light.getSkyHorizontalIlluminance()},
                {"zenithLuminance", light.getZenithLuminance()},
                {"maxDirectNormalIlluminance", light.getMaxDirectNormalIlluminance()}};
}

std::string degreesNumber(float radians) { return fixedNumber(radians * 180 / std::numbers::pi, 1); }
std::string luxNumber(float lux) { return fixedNumber(lux, 0); }

std::string vectorText(const RnNaturalLight::Triple& v) {
    return fixedNumber(v[0], 3) + ", " + fixedNumber(v[1], 3) + ", " + fixedNumber(v[2], 3);
}

/// Why there is neither sunrise nor sunset; null when there are.
const char* polarText(RnNaturalLight& light) {
    constexpr float noise = 1e-4F;  // of clock times, in hours
    const float daylight = light.getSunset() - light.getSunrise();
    return daylight < noise ? "the sun stays down" : daylight > hoursInDay - noise ? "the sun stays up" : nullptr;
}

void addPlaceAndTime(Table& table, RnNaturalLight& light, const NumberedFunctions& functions) {
    const std::string equation = fixedNumber(60 * light.getEquationOfTime(), 1) + " min";
    const char* saving = light.getDaylightSaving() ? ", daylight saving time" : "";
    table.add(
        {"Place", sideText(light.getLatitude(), 'N', 'S') + ", " + sideText(light.getLongitude(), 'W', 'E')});
    table.add({"Date", dateText(light, functions)});
    table.add({"Clock", clockText(functions, light.getLocalTime()) + ", " +
                            utcText(functions, light.getTimeZoneHours()) + saving});
    table.add({"Solar time", clockText(functions, light.getSolarTime()) + ", equation of time " + equation});
}

void addRiseAndSet(Table& table, RnNaturalLight& light, const NumberedFunctions& functions) {
    const auto both = [&](float local, float solar) {
        return clockText(functions, local) + " by the clock, " + clockText(functions, solar) + " solar time";
    };
    const char* polar = polarText(light);
    table.add({"Sunrise", polar ? polar : both(light.getSunrise(), light.getSunriseSolarTime())});
    table.add({"Solar noon", clockText(functions, light.getSolarNoon()) + " by the clock"});
    table.add({"Sunset", polar ? polar : both(light.getSunset(), light.getSunsetSolarTime())});
}

void addLight(Table& table, RnNaturalLight& light) {
    table.add({"Altitude", degreesNumber(light.getSolarAltitude()) + " deg, " +
                               degreesNumber(light.getSolarZenith()) + " deg from the zenith"});
    table.add({"Azimuth", degreesNumber(light.getSolarAzimuth()) + " deg; 0 is south, positive towards west"});
    table.add({"Direction", vectorText(light.getSunDirection()) + "; x east, y north, z up, north turned by " +
                                shortNumber(light.getNorth()) + " deg"});
    table.add({"Sky", std::string(skyText(light.getSkyCover())) + ", cover " + shortNumber(light.getSkyCover())});
    table.add({"Sunlight", luxNumber(light.getDirectNormalIlluminance()) + " lux facing the sun, " +
                               luxNumber(light.getDirectHorizontalIlluminance()) + " lux on the ground; at most " +
                               luxNumber(light.getMaxDirectNormalIlluminance()) + " lux"});
    table.add({"Skylight", luxNumber(light.getSkyHorizontalIlluminance()) + " lux on the ground; zenith " +
                               luxNumber(light.getZenithLuminance()) + " cd/m2"});
}

void printText(RnNaturalLight& light, const NumberedFunctions& functions) {
    light.getSolarTime();  // where it was given, the local time follows from it
    Table table;
    addPlaceAndTime(table, light, functions);
    addRiseAndSet(table, light, functions);
    addLight(table, light);
    table.print();
}

void printDayTable(RnNaturalLight& light, const NumberedFunctions& functions, bool json) {
    Table table;
    table.add({"clock", "solar time", "altitude, deg", "azimuth, deg", "facing the sun, lux", "sun on ground, lux",
               "sky on ground, lux"});
    for (int hour = 0; hour < hoursInDay; ++hour) {
        light.setLocalTime(static_cast<float>(hour));
        if (json) {
            printLine(sunJson(light));
            continue;
        }
        table.add({padLeft(clockText(functions, light.getLocalTime()), 5),
                   padLeft(clockText(functions, light.getSolarTime()), 10),
                   padLeft(degreesNumber(light.getSolarAltitude()), 13),
                   padLeft(degreesNumber(light.getSolarAzimuth()), 12),
                   padLeft(luxNumber(light.getDirectNormalIlluminance()), 19),
                   padLeft(luxNumber(light.getDirectHorizontalIlluminance()), 18),
                   padLeft(luxNumber(light.getSkyHorizontalIlluminance()), 18)});
    }
    if (json) return;
    std::cout << dateText(light, functions) << '\n';
    table.print();
    std::cout << azimuthNote << '\n';
}

/// A time as a cell of a table; "-" for a sun that neither rises nor sets.
std::string timeCell(const NumberedFunctions& functions, float hours, bool shown = true) {
    return padLeft(shown ? clockText(functions, hours) : "-", 7);
}

void printYearTable(RnNaturalLight& light, const NumberedFunctions& functions, bool json) {
    Table table;
    table.add({"date", "sunrise", "noon", "sunset"});
    for (int month = 1; month <= monthsInYear; ++month) {
        light.setDate(month, yearTableDay);
        const float sunrise = light.getSunrise(), noon = light.getSolarNoon(), sunset = light.getSunset();
        const char* polar = polarText(light);
        if (json) {
            printLine(Json{{"month", month},
                           {"day", yearTableDay},
                           {"sunrise", sunrise},
                           {"solarNoon", noon},
                           {"sunset", sunset}});
            continue;
        }
        std::vector<std::string> row{
            std::to_string(yearTableDay) + " " + toUtf8(functions.getMonthShortName(month)),
            timeCell(functions, sunrise, !polar), timeCell(functions, noon), timeCell(functions, sunset, !polar)};
        if (polar) row.push_back(polar);
        table.add(std::move(row));
    }
    if (json) return;
    table.print();
    std::cout << "Clock times" << (light.getDaylightSaving() ? " with daylight saving all year" : "") << ", "
              << utcText(functions, light.getTimeZoneHours()) << ".\n";
}

int runSun(const SunOptions& options, const HostSession& session) {
    const auto light = makeLight(session, options.light, options.json);
    if (!light) return exitFailed;
    showOutOfRange(*light);
    const NumberedFunctions functions = session.functions();
    if (options.dayTable) {
        printDayTable(*light, functions, options.json);
    } else if (options.yearTable) {
        printYearTable(*light, functions, options.json);
    } else if (options.json) {
        printLine(sunJson(*light));
    } else {
        printText(*light, functions);
    }
    return exitWell;
}

}  // namespace

Action declareSun(CLI::App& app) {
    auto options = std::make_shared<SunOptions>();
    addLightOptions(app, options->light);
    auto* day = app.add_flag("--day-table", options->dayTable, "The day, hour by hour of the clock");
    auto* year =
        app.add_flag("--year-table", options->yearTable, "Sunrise, noon and sunset on the 21st of each month");
    day->excludes(year);
    addJsonFlag(app, options->json);
    return [options](const HostSession& session) { return runSun(*options, session); };
}

}  // namespace OvTool
