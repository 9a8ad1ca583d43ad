#include <CLI/CLI.hpp>
#include <memory>

#include "tools/ovphoto/commands/daylightOptions.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/placeAndTime.h"
#include "tools/ovphoto/table.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

using namespace Ov;

namespace {

struct SettingsOptions {
    std::string file;
    DaylightOptions naturalLight;
    bool binary = false;
    bool json = false;
};

const char* yesNo(bool value) { return value ? inLanguage("yes", "ja") : inLanguage("no", "nein"); }

std::string colorText(const RnNaturalLight::Triple& color) {
    return shortNumber(color[0]) + ", " + shortNumber(color[1]) + ", " + shortNumber(color[2]);
}

std::string flagsText(bool shadows, bool second, bool third) {
    return inLanguage("casts shadows ", "wirft Schatten: ") + std::string(yesNo(shadows)) +
           inLanguage(", second flag ", ", zweites Merkmal: ") + yesNo(second) +
           inLanguage(", third flag ", ", drittes Merkmal: ") + yesNo(third);
}

std::string angleText(float radians) { return degreesText(shortNumber(toDegrees(radians))); }

const char* computed() { return inLanguage("computed", "berechnet"); }

std::string positionText(const NaturalLightSettings& s) {
    if (!s.overrideSolarPosition) return computed();
    return inLanguage("altitude ", "Höhe ") + angleText(s.solarAltitude) + inLanguage(", azimuth ", ", Azimut ") +
           angleText(s.solarAzimuth) + " (" + azimuthRule() + ")";
}

void printText(const RnNaturalLight& naturalLight, const NaturalLightSettings& s,
               const OvPhotometrics::NumberedFunctions& functions) {
    Table table;
    table.add({inLanguage("Natural light", "Tageslicht"),
               inLanguage(s.enabled ? "on" : "off", s.enabled ? "ein" : "aus") + std::string(", ") +
                   inLanguage(s.outside ? "out" : "in", s.outside ? "außen" : "innen")});
    table.add({inLanguage("Latitude", "Breite"), latitudeText(naturalLight.getLatitude())});
    table.add({inLanguage("Longitude", "Länge"), longitudeText(naturalLight.getLongitude())});
    table.add({inLanguage("North", "Norden"),
               angleText(s.north) + inLanguage(" added to azimuths", " zu Azimuten addiert")});
    table.add({inLanguage("Date", "Datum"), dateText(naturalLight, functions)});
    table.add({inLanguage("Clock", "Uhrzeit"), clockText(functions, s.localTime)});
    table.add({inLanguage("Time zone", "Zeitzone"), utcText(functions, naturalLight.getTimeZoneHours())});
    table.add({inLanguage("Daylight saving", "Sommerzeit"), yesNo(s.daylightSaving)});
    table.add({inLanguage("Sky cover", "Bedeckung"), shortNumber(s.skyCover)});
    table.add({inLanguage("Sun position", "Sonnenstand"), positionText(s)});
    table.add({inLanguage("Sun, facing it", "Zur Sonne hin"),
               s.overrideSolarIlluminance ? shortNumber(s.directNormalIlluminance) + inLanguage(" lux", " Lux")
                                          : computed()});
    table.add({inLanguage("Sun color", "Sonnenfarbe"), colorText(s.sunColor)});
    table.add({inLanguage("Sky color", "Himmelsfarbe"), colorText(s.skyColor)});
    table.add({inLanguage("Sun", "Sonne"), flagsText(s.sunCastsShadows, s.sunFlag2, s.sunFlag3)});
    table.add({inLanguage("Sky", "Himmel"), flagsText(s.skyCastsShadows, s.skyFlag2, s.skyFlag3)});
    table.add({inLanguage("Sky shadows", "Himmelsschatten"),
               inLanguage("accuracy ", "Genauigkeit ") + shortNumber(s.skyShadowAccuracy)});
    table.print(2);
}

/// The record as it is: angles in radians.
Json recordJson(const NaturalLightSettings& s) {
    return Json{{"enabled", s.enabled},
                {"outside", s.outside},
                {"north", s.north},
                {"latitude", s.latitude},
                {"longitude", s.longitude},
                {"day", s.day},
                {"daylightSaving", s.daylightSaving},
                {"localTime", s.localTime},
                {"timeZone", s.timeZone},
                {"skyCover", s.skyCover},
                {"skyShadowAccuracy", s.skyShadowAccuracy},
                {"sunCastsShadows", s.sunCastsShadows},
                {"sunFlag2", s.sunFlag2},
                {"sunFlag3", s.sunFlag3},
                {"skyCastsShadows", s.skyCastsShadows},
                {"skyFlag2", s.skyFlag2},
                {"skyFlag3", s.skyFlag3},
                {"sunColor", s.sunColor},
                {"skyColor", s.skyColor},
                {"overrideSolarPosition", s.overrideSolarPosition},
                {"solarAltitude", s.solarAltitude},
                {"solarAzimuth", s.solarAzimuth},
                {"overrideSolarIlluminance", s.overrideSolarIlluminance},
                {"directNormalIlluminance", s.directNormalIlluminance}};
}

int runShow(const SettingsOptions& options, const HostSession& session) {
    const auto naturalLight = makeDaylight(session, {options.file, {}, {}}, options.json);
    if (!naturalLight) return exitFailed;
    NaturalLightSettings settings;
    naturalLight->getSettings(settings);
    if (options.json) {
        printLine(recordJson(settings));
    } else {
        say(options.file);
        printText(*naturalLight, settings, session.functions());
    }
    return exitWell;
}

int runWrite(const SettingsOptions& options, const HostSession& session) {
    std::string error = InputFiles({options.naturalLight.from}).refusal(options.file);
    if (error.empty()) {
        const auto naturalLight = makeDaylight(session, options.naturalLight, false);
        if (!naturalLight) return exitFailed;
        naturalLight->getSolarTime();  // a solar time that was given becomes a local time, which is what is saved
        const auto form = options.binary ? RnStream::Form::binary : RnStream::Form::text;
        error = writeFile(options.file, savedDaylight(*naturalLight, form));
    }
    if (error.empty()) return exitWell;
    complain(options.file + ": " + error);
    return exitFailed;
}

}  // namespace

Action declareSettings(CLI::App& app) {
    auto options = std::make_shared<SettingsOptions>();
    app.require_subcommand(1);
    CLI::App* show = app.add_subcommand("show", "Show what is saved in a file of either form");
    show->add_option("FILE", options->file, "Saved settings")->required();
    addJsonFlag(*show, options->json);
    CLI::App* write = app.add_subcommand("write", "Write a file of settings");
    write->add_option("FILE", options->file, "File to write")->required();
    write->add_flag("--binary", options->binary, "Write the binary form instead of text");
    addDaylightOptions(*write, options->naturalLight);
    return [options, show](const HostSession& session) {
        return show->parsed() ? runShow(*options, session) : runWrite(*options, session);
    };
}

}  // namespace OvTool
