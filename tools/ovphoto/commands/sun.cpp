#include <CLI/CLI.hpp>
#include <memory>
#include <numbers>

#include "components/support/path.h"
#include "tools/ovphoto/commands/lightOptions.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/lightText.h"
#include "tools/ovphoto/table.h"
#include "tools/ovphoto/terminal.h"

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

/// Adds an angle in radians, as the interface gives it, and in degrees.
void addAngle(Json& object, const std::string& key, float radians, double degrees) {
    object[key] = radians;
    object[key + "Degrees"] = static_cast<float>(degrees);
}

void addAngle(Json& object, const std::string& key, float radians) {
    addAngle(object, key, radians, radians * 180 / std::numbers::pi);
}

/// The place and its clock.
Json siteJson(const RnNaturalLight& light) {
    NaturalLightSettings settings;
    light.getSettings(settings);
    Json site;
    addAngle(site, "latitude", settings.latitude, light.getLatitude());
    addAngle(site, "longitude", settings.longitude, light.getLongitude());
    addAngle(site, "north", settings.north, light.getNorth());
    site["timeZoneHours"] = light.getTimeZoneHours();
    site["daylightSaving"] = light.getDaylightSaving();
    return site;
}

/// The site, and every derived value as the interface gives it.
Json sunJson(RnNaturalLight& light) {
    const float solarTime = light.getSolarTime();  // first: where it was given, the local time follows from it
    Json sun{{"site", siteJson(light)},
             {"day", light.getDayOfYear()},
             {"localTime", light.getLocalTime()},
             {"solarTime", solarTime},
             {"equationOfTime", light.getEquationOfTime()},
             {"sunrise", light.getSunrise()},
             {"sunset", light.getSunset()},
             {"solarNoon", light.getSolarNoon()},
             {"sunriseSolarTime", light.getSunriseSolarTime()},
             {"sunsetSolarTime", light.getSunsetSolarTime()}};
    addAngle(sun, "solarAltitude", light.getSolarAltitude());
    addAngle(sun, "solarAzimuth", light.getSolarAzimuth());
    addAngle(sun, "solarZenith", light.getSolarZenith());
    sun.update(Json{{"sunDirection", light.getSunDirection()},
                    {"directNormalIlluminance", light.getDirectNormalIlluminance()},
                    {"directHorizontalIlluminance", light.getDirectHorizontalIlluminance()},
                    {"skyHorizontalIlluminance", light.getSkyHorizontalIlluminance()},
                    {"zenithLuminance", light.getZenithLuminance()},
                    {"maxDirectNormalIlluminance", light.getMaxDirectNormalIlluminance()}});
    return sun;
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
    return daylight < noise ? inLanguage("the sun stays down", "die Sonne bleibt unter dem Horizont")
           : daylight > hoursInDay - noise ? inLanguage("the sun stays up", "die Sonne bleibt über dem Horizont")
                                           : nullptr;
}

void addPlaceAndTime(Table& table, RnNaturalLight& light, const NumberedFunctions& functions) {
    const std::string equation = fixedNumber(60 * light.getEquationOfTime(), 1) + " min";
    const char* saving = light.getDaylightSaving() ? inLanguage(", daylight saving time", ", Sommerzeit") : "";
    table.add({inLanguage("Place", "Ort"),
               latitudeText(light.getLatitude()) + ", " + longitudeText(light.getLongitude())});
    table.add({inLanguage("Date", "Datum"), dateText(light, functions)});
    table.add({inLanguage("Clock", "Uhrzeit"), clockText(functions, light.getLocalTime()) + ", " +
                                                   utcText(functions, light.getTimeZoneHours()) + saving});
    table.add({inLanguage("Solar time", "Sonnenzeit"), clockText(functions, light.getSolarTime()) +
                                                           inLanguage(", equation of time ", ", Zeitgleichung ") +
                                                           equation});
}

void addRiseAndSet(Table& table, RnNaturalLight& light, const NumberedFunctions& functions) {
    const std::string byClock = inLanguage(" by the clock", " nach der Uhr");
    const auto both = [&](float local, float solar) {
        return clockText(functions, local) + byClock + ", " + clockText(functions, solar) +
               inLanguage(" solar time", " Sonnenzeit");
    };
    const char* polar = polarText(light);
    table.add({inLanguage("Sunrise", "Sonnenaufgang"),
               polar ? polar : both(light.getSunrise(), light.getSunriseSolarTime())});
    table.add({inLanguage("Solar noon", "Höchststand"), clockText(functions, light.getSolarNoon()) + byClock});
    table.add({inLanguage("Sunset", "Sonnenuntergang"),
               polar ? polar : both(light.getSunset(), light.getSunsetSolarTime())});
}

void addLight(Table& table, RnNaturalLight& light) {
    const auto degrees = [](float radians) { return degreesText(degreesNumber(radians)); };
    const auto lux = [](float value, const char* english, const char* german) {
        return luxNumber(value) + inLanguage(" lux ", " Lux ") + inLanguage(english, german);
    };
    table.add({inLanguage("Altitude", "Höhe"), degrees(light.getSolarAltitude()) + ", " +
                                                   degrees(light.getSolarZenith()) +
                                                   inLanguage(" from the zenith", " vom Zenit")});
    table.add({inLanguage("Azimuth", "Azimut"), degrees(light.getSolarAzimuth()) + "; " + azimuthRule()});
    table.add(
        {inLanguage("Direction", "Richtung"), vectorText(light.getSunDirection()) +
                                                  inLanguage("; x east, y north, z up, north turned by ",
                                                             "; x Osten, y Norden, z oben, Norden gedreht um ") +
                                                  degreesText(shortNumber(light.getNorth()))});
    table.add({inLanguage("Sky", "Himmel"), std::string(skyText(light.getSkyCover())) +
                                                inLanguage(", cover ", ", Bedeckung ") +
                                                shortNumber(light.getSkyCover())});
    table.add({inLanguage("Sunlight", "Sonnenlicht"),
               lux(light.getDirectNormalIlluminance(), "facing the sun, ", "zur Sonne hin, ") +
                   lux(light.getDirectHorizontalIlluminance(), "on the ground; at most ", "am Boden; höchstens ") +
                   luxNumber(light.getMaxDirectNormalIlluminance()) + inLanguage(" lux", " Lux")});
    table.add({inLanguage("Skylight", "Himmelslicht"),
               lux(light.getSkyHorizontalIlluminance(), "on the ground; zenith ", "am Boden; Zenit ") +
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
        light.setLocalTime(static_cast<float>(hour));
        if (json) {
            printLine(sunJson(light));
            continue;
        }
        std::vector<std::string> row{
            clockText(functions, light.getLocalTime()),    clockText(functions, light.getSolarTime()),
            degreesNumber(light.getSolarAltitude()),       degreesNumber(light.getSolarAzimuth()),
            luxNumber(light.getDirectNormalIlluminance()), luxNumber(light.getDirectHorizontalIlluminance()),
            luxNumber(light.getSkyHorizontalIlluminance())};
        for (std::size_t i = 0; i < row.size(); ++i) row[i] = padLeft(row[i], characterCount(headings[i]));
        table.add(std::move(row));
    }
    if (json) return;
    say(dateText(light, functions));
    table.print();
    say(azimuthSentence());
}

/// A time as a cell of a table; "-" for a sun that neither rises nor sets.
std::string timeCell(const NumberedFunctions& functions, float hours, bool shown = true) {
    return padLeft(shown ? clockText(functions, hours) : "-", 7);
}

void printYearTable(RnNaturalLight& light, const NumberedFunctions& functions, bool json) {
    Table table;
    table.add({inLanguage("date", "Datum"), inLanguage("sunrise", "Aufgang"), inLanguage("noon", "höchste"),
               inLanguage("sunset", "Untergang")});
    for (int month = 1; month <= monthsInYear; ++month) {
        light.setDate(month, yearTableDay);
        const float sunrise = light.getSunrise(), noon = light.getSolarNoon(), sunset = light.getSunset();
        const char* polar = polarText(light);
        if (json) {
            printLine(Json{{"site", siteJson(light)},
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
        (light.getDaylightSaving() ? inLanguage(" with daylight saving all year", " mit Sommerzeit das ganze Jahr")
                                   : "") +
        ", " + utcText(functions, light.getTimeZoneHours()) + ".");
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
