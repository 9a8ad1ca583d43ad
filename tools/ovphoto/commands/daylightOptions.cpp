#include "tools/ovphoto/commands/daylightOptions.h"

#include <algorithm>

#include "tools/numbers/numbers.h"
#include "tools/ovphoto/commands/parsedOption.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/placeAndTime.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

using namespace Ov;

namespace {

/// Declares an option whose value `apply` sets on the object.
template <class Parse, class Apply>
CLI::Option* addChange(CLI::App& app, DaylightOptions& options, const OptionText& text, Parse parse, Apply apply) {
    return addParsed(app, text, parse, [&options, apply](const auto& value) {
        options.changes.push_back(
            [apply, value](RnNaturalLight& naturalLight, const auto&) { apply(naturalLight, value); });
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

/// Hours where they can be told without the module, which knows the names of zones.
struct Zone {
    std::optional<float> hours;
    std::string name;
};

std::optional<Zone> parseZone(const std::string& text) {
    const auto hours = parseZoneHours(text);
    // What looks like hours is no name.
    const bool isName = !text.empty() && text.find_first_of("0123456789") == std::string::npos;
    if (hours || isName) return Zone{hours, text};
    throw CLI::ValidationError("--time-zone",
                               "'" + text +
                                   "' is no time zone: hours behind Greenwich (5 in New York, -1 in "
                                   "Berlin), UTC-5 or UTC+1, or a name that `zones` prints");
}

CLI::Option* addZone(CLI::App& app, DaylightOptions& options) {
    static constexpr OptionText text{
        "--time-zone", "HOURS|UTC+H|NAME",
        "Hours behind Greenwich, west positive (5 in New York, -1 in Berlin); or behind "
        "UTC as clocks count, east positive (UTC-5, UTC+1); or a name as `zones` prints "
        "it"};
    return addParsed(app, text, parseZone, [&options](const Zone& zone) {
        options.changes.push_back(
            [zone](RnNaturalLight& naturalLight, const OvPhotometrics::NumberedFunctions& functions) {
                const auto hours = zone.hours ? zone.hours : findZoneHours(zone.name, functions);
                if (!hours) throw CLI::ValidationError(text.name, "`zones` lists no '" + zone.name + "'");
                naturalLight.setTimeZoneHours(*hours);
            });
    });
}

void addSite(CLI::App& app, DaylightOptions& options) {
    auto* latitude = addChange(
        app, options, {"--latitude", "DEG|DEG[N|S]", "Latitude, north positive"},
        [](const std::string& text) { return parseSide(text, northSouth); },
        [](RnNaturalLight& naturalLight, float degrees) { naturalLight.setLatitude(degrees); });
    auto* longitude = addChange(
        app, options, {"--longitude", "DEG|DEG[W|E]", "Longitude, west positive"},
        [](const std::string& text) { return parseSide(text, westEast); },
        [](RnNaturalLight& naturalLight, float degrees) { naturalLight.setLongitude(degrees); });
    options.site = {latitude, longitude, addZone(app, options)};
    addChange(app, options, {"--north", "DEG", "Added to azimuths to turn them into the scene"}, parseFloat,
              [](RnNaturalLight& naturalLight, float degrees) { naturalLight.setNorth(degrees); });
}

void addTime(CLI::App& app, DaylightOptions& options) {
    auto* date = addChange(
        app, options, {"--date", "[YYYY-]MM-DD", "Date, in a year of 365 days; which year plays no part"},
        parseDate, [](RnNaturalLight& naturalLight, Date value) { naturalLight.setDate(value.month, value.day); });
    auto* day = addChange(app, options, {"--day", "N", "Day of the year, 1 to 365"}, parseDay,
                          [](RnNaturalLight& naturalLight, int value) {
                              naturalLight.setDayOfYear(static_cast<std::uint16_t>(value));
                          });
    date->excludes(day);
    auto* local = addChange(app, options, {"--time", "H|H:MM", "Time that the clock shows"}, parseHours,
                            [](RnNaturalLight& naturalLight, float hours) { naturalLight.setLocalTime(hours); });
    auto* solar =
        addChange(app, options, {"--solar-time", "H|H:MM", "Time by the sun, instead; at 12 the sun is highest"},
                  parseHours, [](RnNaturalLight& naturalLight, float hours) { naturalLight.setSolarTime(hours); });
    local->excludes(solar);
    addChange(app, options, {"--daylight-saving", "yes|no", "Whether the clock is an hour ahead"}, parseYesNo,
              [](RnNaturalLight& naturalLight, bool on) { naturalLight.setDaylightSaving(on); });
}

void addSky(CLI::App& app, DaylightOptions& options) {
    addChange(app, options, {"--sky-cover", "C", "Cloud cover, 0 (clear) to 1 (overcast)"}, parseFloat,
              [](RnNaturalLight& naturalLight, float cover) { naturalLight.setSkyCover(cover); });
    addChange(app, options,
              {"--sun-position", "ALT,AZ",
               "Altitude and azimuth of the sun (degrees; azimuth 0 south, west positive), not computed"},
              parseList<2>, [](RnNaturalLight& naturalLight, const std::array<float, 2>& degrees) {
                  naturalLight.setOverrideSolarPosition(true);
                  naturalLight.setSolarPosition(toRadians(degrees[0]), toRadians(degrees[1]));
              });
    addChange(app, options,
              {"--illuminance", "LUX", "The sun's illuminance facing it, instead of the computed one"},
              parseIlluminance, [](RnNaturalLight& naturalLight, float lux) {
                  naturalLight.setOverrideSolarIlluminance(true);
                  naturalLight.setDirectNormalIlluminance(lux);
              });
}

/// Whether the options name a site.
bool namesSite(const DaylightOptions& options) {
    const auto given = std::count_if(options.site.begin(), options.site.end(),
                                     [](const CLI::Option* option) { return option->count() > 0; });
    if (given > 0 && given < std::ssize(options.site) && options.from.empty())
        throw CLI::ValidationError("--latitude, --longitude and --time-zone", "a site takes all three, or --from");
    return given > 0 || !options.from.empty();
}

}  // namespace

void addDaylightOptions(CLI::App& app, DaylightOptions& options) {
    app.add_option("--from", options.from, "Saved settings to start from, of either form")->type_name("FILE");
    addSite(app, options);
    addTime(app, options);
    addSky(app, options);
}

RnRef<RnNaturalLight> makeDaylight(const HostSession& session, const DaylightOptions& options, bool json) {
    const bool sited = namesSite(options);
    RnRef<RnNaturalLight> naturalLight = createDaylight(session);
    if (!options.from.empty()) {
        std::vector<std::string> reasons;
        const bool loaded = loadDaylight(*naturalLight, options.from, reasons);
        showReasons(options.from, reasons);
        if (!loaded && json) printRefusal(options.from, reasons);
        if (!loaded) return {};
    }
    const auto functions = session.functions();
    for (const auto& change : options.changes) change(*naturalLight, functions);
    if (!sited)
        complain(inLanguage("note: no site is given; taken is ", "Hinweis: Kein Ort ist angegeben; es gilt ") +
                 siteText(*naturalLight, functions));
    return naturalLight;
}

void showOutOfRange(const RnNaturalLight& naturalLight) {
    for (const std::string& note : outOfRange(naturalLight)) complain(inLanguage("note: ", "Hinweis: ") + note);
}

}  // namespace OvTool
