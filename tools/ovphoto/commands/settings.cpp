#include <CLI/CLI.hpp>
#include <iostream>
#include <memory>

#include "tools/ovphoto/commands/lightOptions.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/lightText.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/table.h"

namespace OvTool {

using namespace Ov;

namespace {

struct SettingsOptions {
    std::string file;
    LightOptions light;
    bool binary = false;
    bool json = false;
};

const char* yesNo(bool value) { return value ? "yes" : "no"; }

std::string colorText(const RnNaturalLight::Triple& color) {
    return shortNumber(color[0]) + ", " + shortNumber(color[1]) + ", " + shortNumber(color[2]);
}

std::string flagsText(bool shadows, bool second, bool third) {
    return std::string("casts shadows ") + yesNo(shadows) + ", second flag " + yesNo(second) + ", third flag " +
           yesNo(third);
}

std::string degreesText(float radians) { return shortNumber(toDegrees(radians)) + " deg"; }

std::string positionText(const NaturalLightSettings& s) {
    if (!s.overrideSolarPosition) return "computed";
    return "altitude " + degreesText(s.solarAltitude) + ", azimuth " + degreesText(s.solarAzimuth) +
           " (0 is south, positive towards west)";
}

void printText(const RnNaturalLight& light, const NaturalLightSettings& s,
               const OvPhotometrics::NumberedFunctions& functions) {
    Table table;
    table.add({"Natural light", std::string(s.enabled ? "on" : "off") + ", " + (s.outside ? "out" : "in")});
    table.add({"Latitude", sideText(light.getLatitude(), 'N', 'S')});
    table.add({"Longitude", sideText(light.getLongitude(), 'W', 'E')});
    table.add({"North", degreesText(s.north) + " added to azimuths"});
    table.add({"Date", dateText(light, functions)});
    table.add({"Clock", clockText(functions, s.localTime)});
    table.add({"Time zone", utcText(functions, light.getTimeZoneHours())});
    table.add({"Daylight saving", yesNo(s.daylightSaving)});
    table.add({"Sky cover", shortNumber(s.skyCover)});
    table.add({"Sun position", positionText(s)});
    table.add({"Sun, facing it",
               s.overrideSolarIlluminance ? shortNumber(s.directNormalIlluminance) + " lux" : "computed"});
    table.add({"Sun color", colorText(s.sunColor)});
    table.add({"Sky color", colorText(s.skyColor)});
    table.add({"Sun", flagsText(s.sunCastsShadows, s.sunFlag2, s.sunFlag3)});
    table.add({"Sky", flagsText(s.skyCastsShadows, s.skyFlag2, s.skyFlag3)});
    table.add({"Sky shadows", "accuracy " + shortNumber(s.skyShadowAccuracy)});
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
    const auto light = makeLight(session, {options.file, {}}, options.json);
    if (!light) return exitFailed;
    NaturalLightSettings settings;
    light->getSettings(settings);
    if (options.json) {
        printLine(recordJson(settings));
    } else {
        std::cout << options.file << '\n';
        printText(*light, settings, session.functions());
    }
    return exitWell;
}

int runWrite(const SettingsOptions& options, const HostSession& session) {
    const auto light = makeLight(session, options.light, false);
    if (!light) return exitFailed;
    light->getSolarTime();  // a solar time that was given becomes a local time, which is what is saved
    const auto form = options.binary ? RnStream::Form::binary : RnStream::Form::text;
    const std::string error = writeFile(options.file, savedLight(*light, form));
    if (error.empty()) return exitWell;
    std::cerr << options.file << ": " << error << '\n';
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
    addLightOptions(*write, options->light);
    return [options, show](const HostSession& session) {
        return show->parsed() ? runShow(*options, session) : runWrite(*options, session);
    };
}

}  // namespace OvTool
