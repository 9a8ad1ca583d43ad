#include "tools/ovphoto/commands/lightOptions.h"

#include <iostream>

#include "tools/ovphoto/commands/parsedOption.h"
#include "tools/ovphoto/lightText.h"
#include "tools/ovphoto/numbers.h"

namespace OvTool {

using namespace Ov;

namespace {

/// Declares an option whose value `apply` sets on the object.
template <class Parse, class Apply>
CLI::Option* addChange(CLI::App& app, LightOptions& options, const OptionText& text, Parse parse, Apply apply) {
    return addParsed(app, text, parse, [&options, apply](const auto& value) {
        options.changes.push_back([apply, value](RnNaturalLight& light) { apply(light, value); });
    });
}

std::optional<bool> parseYesNo(std::string_view text) {
    if (text == "yes") return true;
    if (text == "no") return false;
    return {};
}

std::optional<float> parseIlluminance(std::string_view text) {
    const auto lux = parseFloat(text);
    return lux && *lux >= 0 ? lux : std::nullopt;
}

void addSite(CLI::App& app, LightOptions& options) {
    addChange(
        app, options, {"--latitude", "DEG|DEG[N|S]", "Latitude, north positive"},
        [](const std::string& text) { return parseSide(text, 'N', 'S'); },
        [](RnNaturalLight& light, float degrees) { light.setLatitude(degrees); });
    addChange(
        app, options, {"--longitude", "DEG|DEG[W|E]", "Longitude, west positive"},
        [](const std::string& text) { return parseSide(text, 'W', 'E'); },
        [](RnNaturalLight& light, float degrees) { light.setLongitude(degrees); });
    addChange(app, options, {"--north", "DEG", "Added to azimuths to turn them into the scene"}, parseFloat,
              [](RnNaturalLight& light, float degrees) { light.setNorth(degrees); });
}

void addTime(CLI::App& app, LightOptions& options) {
    auto* date = addChange(app, options, {"--date", "MM-DD", "Date, in a year of 365 days"}, parseDate,
                           [](RnNaturalLight& light, Date value) { light.setDate(value.month, value.day); });
    auto* day =
        addChange(app, options, {"--day", "N", "Day of the year, 1 to 365"}, parseDay,
                  [](RnNaturalLight& light, int value) { light.setDayOfYear(static_cast<std::uint16_t>(value)); });
    date->excludes(day);
    auto* local = addChange(app, options, {"--time", "H|H:MM", "Time that the clock shows"}, parseHours,
                            [](RnNaturalLight& light, float hours) { light.setLocalTime(hours); });
    auto* solar =
        addChange(app, options, {"--solar-time", "H|H:MM", "Time by the sun, instead; at 12 the sun is highest"},
                  parseHours, [](RnNaturalLight& light, float hours) { light.setSolarTime(hours); });
    local->excludes(solar);
    addChange(app, options, {"--time-zone", "HOURS", "Hours behind Greenwich, west positive"}, parseFloat,
              [](RnNaturalLight& light, float hours) { light.setTimeZoneHours(hours); });
    addChange(app, options, {"--daylight-saving", "yes|no", "Whether the clock is an hour ahead"}, parseYesNo,
              [](RnNaturalLight& light, bool on) { light.setDaylightSaving(on); });
}

void addSky(CLI::App& app, LightOptions& options) {
    addChange(app, options, {"--sky-cover", "C", "Cloud cover, 0 (clear) to 1 (overcast)"}, parseFloat,
              [](RnNaturalLight& light, float cover) { light.setSkyCover(cover); });
    addChange(app, options,
              {"--sun-position", "ALT,AZ",
               "Altitude and azimuth of the sun (degrees; azimuth 0 south, west positive), not computed"},
              parseList<2>, [](RnNaturalLight& light, const std::array<float, 2>& degrees) {
                  light.setOverrideSolarPosition(true);
                  light.setSolarPosition(toRadians(degrees[0]), toRadians(degrees[1]));
              });
    addChange(app, options,
              {"--illuminance", "LUX", "The sun's illuminance facing it, instead of the computed one"},
              parseIlluminance, [](RnNaturalLight& light, float lux) {
                  light.setOverrideSolarIlluminance(true);
                  light.setDirectNormalIlluminance(lux);
              });
}

}  // namespace

void addLightOptions(CLI::App& app, LightOptions& options) {
    app.add_option("--from", options.from, "Saved settings to start from, of either form")->type_name("FILE");
    addSite(app, options);
    addTime(app, options);
    addSky(app, options);
}

RnRef<RnNaturalLight> makeLight(const HostSession& session, const LightOptions& options, bool json) {
    RnRef<RnNaturalLight> light = createLight(session);
    if (!options.from.empty()) {
        std::vector<std::string> reasons;
        const bool loaded = loadLight(*light, options.from, reasons);
        showReasons(options.from, reasons);
        if (!loaded && json) printRefusal(options.from, reasons);
        if (!loaded) return {};
    }
    for (const auto& change : options.changes) change(*light);
    return light;
}

void showOutOfRange(const RnNaturalLight& light) {
    for (const std::string& note : outOfRange(light)) std::cerr << "note: " << note << '\n';
}

}  // namespace OvTool
