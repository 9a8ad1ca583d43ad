#include <CLI/CLI.hpp>
#include <memory>
#include <numbers>

#include "components/support/path.h"
#include "tools/ovphoto/commands/daylightOptions.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/placeAndTime.h"
#include "tools/ovphoto/table.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

using namespace Ov;
using OvPhotometrics::NumberedFunctions;

namespace {

struct SunOptions {
    DaylightOptions naturalLight;
    bool dayTable = false;
    bool yearTable = false;
    bool json = false;
};

constexpr int hoursInDay = 24;
constexpr int monthsInYear = 12;
constexpr int yearTableDay = 21;  // of each month: about the solstices and equinoxes

/// Adds an angle in radians, as the interface gives it, and in degrees.
void addAngle(Json& object, const std::string& key, float radians, double degrees) {
    object[key] = radians;
    object[key + "Degrees"] = static_cast<float>(degrees);
}

void addAngle(Json& object, const std::string& key, float radians) {
    addAngle(object, key, radians, radians * 180 / std::numbers::pi);
}

/// The place and its clock.
Json siteJson(const RnNaturalLight& naturalLight) {
    NaturalLightSettings settings;
    naturalLight.getSettings(settings);
    Json site;
    addAngle(site, "latitude", settings.latitude, naturalLight.getLatitude());
    addAngle(site, "longitude", settings.longitude, naturalLight.getLongitude());
    addAngle(site, "north", settings.north, naturalLight.getNorth());
    site["timeZoneHours"] = naturalLight.getTimeZoneHours();
    site["daylightSaving"] = naturalLight.getDaylightSaving();
    return site;
}

/// The site, and every derived value as the interface gives it.
Json sunJson(RnNaturalLight& naturalLight) {
    const float solarTime =
        naturalLight.getSolarTime();  // first: where it was given, the local time follows from it
    Json sun{{"site", siteJson(naturalLight)},
             {"day", naturalLight.getDayOfYear()},
             {"localTime", naturalLight.getLocalTime()},
             {"solarTime", solarTime},
             {"equationOfTime", naturalLight.getEquationOfTime()},
             {"sunrise", naturalLight.getSunrise()},
             {"sunset", naturalLight.getSunset()},
             {"solarNoon", naturalLight.getSolarNoon()},
             {"sunriseSolarTime", naturalLight.getSunriseSolarTime()},
             {"sunsetSolarTime", naturalLight.getSunsetSolarTime()}};
    addAngle(sun, "solarAltitude", naturalLight.getSolarAltitude());
    addAngle(sun, "solarAzimuth", naturalLight.getSolarAzimuth());
    addAngle(sun, "solarZenith", naturalLight.getSolarZenith());
    sun.update(Json{{"sunDirection", naturalLight.getSunDirection()},
                    {"directNormalIlluminance", naturalLight.getDirectNormalIlluminance()},
                    {"directHorizontalIlluminance", naturalLight.getDirectHorizontalIlluminance()},
                    {"skyHorizontalIlluminance", naturalLight.getSkyHorizontalIlluminance()},
                    {"zenithLuminance", naturalLight.getZenithLuminance()},
                    {"maxDirectNormalIlluminance", naturalLight.getMaxDirectNormalIlluminance()}});
    return sun;
}

std::string degreesNumber(float radians) { return fixedNumber(radians * 180 / std::numbers::pi, 1); }
std::string luxNumber(float lux) { return fixedNumber(lux, 0); }

std::string vectorText(const RnNaturalLight::Triple& v) {
    return fixedNumber(v[0], 3) + ", " + fixedNumber(v[1], 3) + ", " + fixedNumber(v[2], 3);
}

/// Why there is neither sunrise nor sunset; null when there are.
const char* polarText(RnNaturalLight& naturalLight) {
    constexpr float noise = 1e-4F;  // of clock times, in hours
    const float daylight = naturalLight.getSunset() - naturalLight.getSunrise();
    return daylight < noise ? inLanguage("the sun stays down", "die Sonne bleibt unter dem Horizont")
           : daylight > hoursInDay - noise ? inLanguage("the sun stays up", "die Sonne bleibt über dem Horizont")
                                           : nullptr;
}

void addPlaceAndTime(Table& table, RnNaturalLight& naturalLight, const NumberedFunctions& functions) {
    const std::string equation = fixedNumber(60 * naturalLight.getEquationOfTime(), 1) + " min";
    const char* saving =
        naturalLight.getDaylightSaving() ? inLanguage(", daylight saving time", ", Sommerzeit") : "";
    table.add({inLanguage("Place", "Ort"),
               latitudeText(naturalLight.getLatitude()) + ", " + longitudeText(naturalLight.getLongitude())});
    table.add({inLanguage("Date", "Datum"), dateText(naturalLight, functions)});
    table.add({inLanguage("Clock", "Uhrzeit"), clockText(functions, naturalLight.getLocalTime()) + ", " +
                                                   utcText(functions, naturalLight.getTimeZoneHours()) + saving});
    table.add({inLanguage("Solar time", "Sonnenzeit"), clockText(functions, naturalLight.getSolarTime()) +
                                                           inLanguage(", equation of time ", ", Zeitgleichung ") +
                                                           equation});
}

void addRiseAndSet(Table& table, RnNaturalLight& naturalLight, const NumberedFunctions& functions) {
    const std::string byClock = inLanguage(" by the clock", " nach der Uhr");
    const auto both = [&](float local, float solar) {
        return clockText(functions, local) + byClock + ", " + clockText(functions, solar) +
               inLanguage(" solar time", " Sonnenzeit");
    };
    const char* polar = polarText(naturalLight);
    table.add({inLanguage("Sunrise", "Sonnenaufgang"),
               polar ? polar : both(naturalLight.getSunrise(), naturalLight.getSunriseSolarTime())});
    table.add(
        {inLanguage("Solar noon", "Höchststand"), clockText(functions, naturalLight.getSolarNoon()) + byClock});
    table.add({inLanguage("Sunset", "Sonnenuntergang"),
               polar ? polar : both(naturalLight.getSunset(), naturalLight.getSunsetSolarTime())});
}

void addLight(Table& table, RnNaturalLight& naturalLight) {
    const auto degrees = [](float radians) { return degreesText(degreesNumber(radians)); };
    const auto lux = [](float value, const char* english, const char* german) {
        return luxNumber(value) + inLanguage(" lux ", " Lux ") + inLanguage(english, german);
    };
    table.add({inLanguage("Altitude", "Höhe"), degrees(naturalLight.getSolarAltitude()) + ", " +
                                                   degrees(naturalLight.getSolarZenith()) +
                                                   inLanguage(" from the zenith", " vom Zenit")});
    table.add({inLanguage("Azimuth", "Azimut"), degrees(naturalLight.getSolarAzimuth()) + "; " + azimuthRule()});
    table.add(
        {inLanguage("Direction", "Richtung"), vectorText(naturalLight.getSunDirection()) +
                                                  inLanguage("; x east, y north, z up, north turned by ",
                                                             "; x Osten, y Norden, z oben, Norden gedreht um ") +
                                                  degreesText(shortNumber(naturalLight.getNorth()))});
    table.add({inLanguage("Sky", "Himmel"), std::string(skyText(naturalLight.getSkyCover())) +
                                                inLanguage(", cover ", ", Bedeckung ") +
                                                shortNumber(naturalLight.getSkyCover())});
    table.add({inLanguage("Sunlight", "Sonnenlicht"),
               lux(naturalLight.getDirectNormalIlluminance(), "facing the sun, ", "zur Sonne hin, ") +
                   lux(naturalLight.getDirectHorizontalIlluminance(), "on the ground; at most ",
                       "am Boden; höchstens ") +
                   luxNumber(naturalLight.getMaxDirectNormalIlluminance()) + inLanguage(" lux", " Lux")});
    table.add({inLanguage("Skylight", "Himmelslicht"),
               lux(naturalLight.getSkyHorizontalIlluminance(), "on the ground; zenith ", "am Boden; Zenit ") +
                   luxNumber(naturalLight.getZenithLuminance()) + " cd/m2"});
}

void printText(RnNaturalLight& naturalLight, const NumberedFunctions& functions) {
    naturalLight.getSolarTime();  // where it was given, the local time follows from it
    Table table;
    addPlaceAndTime(table, naturalLight, functions);
    addRiseAndSet(table, naturalLight, functions);
    addLight(table, naturalLight);
    table.print();
}

void printDayTable(RnNaturalLight& naturalLight, const NumberedFunctions& functions, bool json) {
    const std::string headings[] = {inLanguage("clock", "Uhrzeit"),
                                    inLanguage("solar time", "Sonnenzeit"),
                                    inLanguage("altitude, deg", "Höhe, Grad"),
                                    inLanguage("azimuth, deg", "Azimut, Grad"),
                                    inLanguage("facing the sun, lux", "zur Sonne hin, Lux"),
                                    inLanguage("sun on ground, lux", "Sonne am Boden, Lux"),
                                    inLanguage("sky on ground, lux", "Himmel am Boden, Lux")};
    Table table;
    table.add({std::begin(headings), std::end(headings)});
    for (int hour = 0; hour < hoursInDay; ++hour) {
        naturalLight.setLocalTime(static_cast<float>(hour));
        if (json) {
            printLine(sunJson(naturalLight));
            continue;
        }
        std::vector<std::string> row{clockText(functions, naturalLight.getLocalTime()),
                                     clockText(functions, naturalLight.getSolarTime()),
                                     degreesNumber(naturalLight.getSolarAltitude()),
                                     degreesNumber(naturalLight.getSolarAzimuth()),
                                     luxNumber(naturalLight.getDirectNormalIlluminance()),
                                     luxNumber(naturalLight.getDirectHorizontalIlluminance()),
                                     luxNumber(naturalLight.getSkyHorizontalIlluminance())};
        for (std::size_t i = 0; i < row.size(); ++i) row[i] = padLeft(row[i], characterCount(headings[i]));
        table.add(std::move(row));
    }
    if (json) return;
    say(dateText(naturalLight, functions));
    table.print();
    say(azimuthSentence());
}

/// A time as a cell of a table; "-" for a sun that neither rises nor sets.
std::string timeCell(const NumberedFunctions& functions, float hours, bool shown = true) {
    return padLeft(shown ? clockText(functions, hours) : "-", 7);
}

void printYearTable(RnNaturalLight& naturalLight, const NumberedFunctions& functions, bool json) {
    Table table;
    table.add({inLanguage("date", "Datum"), inLanguage("sunrise", "Aufgang"), inLanguage("noon", "höchste"),
               inLanguage("sunset", "Untergang")});
    for (int month = 1; month <= monthsInYear; ++month) {
        naturalLight.setDate(month, yearTableDay);
        const float sunrise = naturalLight.getSunrise(), noon = naturalLight.getSolarNoon(),
                    sunset = naturalLight.getSunset();
        const char* polar = polarText(naturalLight);
        if (json) {
            printLine(Json{{"site", siteJson(naturalLight)},
                           {"month", month},
                           {"day", yearTableDay},
                           {"sunrise", sunrise},
                           {"solarNoon", noon},
                           {"sunset", sunset}});
            continue;
        }
        std::vector<std::string> row{
            std::to_string(yearTableDay) + inLanguage(" ", ". ") + toUtf8(functions.getMonthShortName(month)),
            timeCell(functions, sunrise, !polar), timeCell(functions, noon), timeCell(functions, sunset, !polar)};
        if (polar) row.push_back(polar);
        table.add(std::move(row));
    }
    if (json) return;
    table.print();
    say(std::string(inLanguage("Clock times", "Uhrzeiten")) +
        (naturalLight.getDaylightSaving()
             ? inLanguage(" with daylight saving all year", " mit Sommerzeit das ganze Jahr")
             : "") +
        ", " + utcText(functions, naturalLight.getTimeZoneHours()) + ".");
}

int runSun(const SunOptions& options, const HostSession& session) {
    const auto naturalLight = makeDaylight(session, options.naturalLight, options.json);
    if (!naturalLight) return exitFailed;
    showOutOfRange(*naturalLight);
    const NumberedFunctions functions = session.functions();
    if (options.dayTable) {
        printDayTable(*naturalLight, functions, options.json);
    } else if (options.yearTable) {
        printYearTable(*naturalLight, functions, options.json);
    } else if (options.json) {
        printLine(sunJson(*naturalLight));
    } else {
        printText(*naturalLight, functions);
    }
    return exitWell;
}

}  // namespace

Action declareSun(CLI::App& app) {
    auto options = std::make_shared<SunOptions>();
    addDaylightOptions(app, options->naturalLight);
    auto* day = app.add_flag("--day-table", options->dayTable, "The day, hour by hour of the clock");
    auto* year =
        app.add_flag("--year-table", options->yearTable, "Sunrise, noon and sunset on the 21st of each month");
    day->excludes(year);
    addJsonFlag(app, options->json);
    return [options](const HostSession& session) { return runSun(*options, session); };
}

}  // namespace OvTool
