#include <cmath>
#include <memory>
#include <optional>

#include "tools/ovphoto/commands/daylightOptions.h"
#include "tools/ovphoto/commands/parsedOption.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/placeAndTime.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

using namespace Ov;

namespace {

using Vector = std::array<float, 3>;

struct SkyOptions {
    DaylightOptions naturalLight;
    std::optional<float> zenith;  // degrees, with the azimuth
    std::optional<float> azimuth;
    std::optional<Vector> normal;
    bool json = false;
};

/// The vector with length 1; one that has it, as far as floats can, stays as it is.
Vector normalised(const Vector& v) {
    const double length = std::hypot(double{v[0]}, double{v[1]}, double{v[2]});
    if (std::abs(length - 1) < 1e-6) return v;
    return {static_cast<float>(v[0] / length), static_cast<float>(v[1] / length),
            static_cast<float>(v[2] / length)};
}

std::optional<float> parseZenith(std::string_view text) {
    const auto degrees = parseFloat(text);
    return degrees && *degrees >= 0 ? degrees : std::nullopt;
}

std::optional<Vector> parseNormal(std::string_view text) {
    const auto vector = parseList<3>(text);
    return vector == Vector{} ? std::nullopt : vector;
}

void printLuminance(RnNaturalLight& naturalLight, const SkyOptions& options) {
    const float luminance = naturalLight.getSkyLuminanceAt(*options.zenith, *options.azimuth);
    if (options.json) return printLine(Json{{"luminance", luminance}});
    say(shortNumber(luminance) + inLanguage(" cd/m2 at zenith angle ", " cd/m2 im Winkel zum Zenit von ") +
        degreesText(shortNumber(*options.zenith)) + inLanguage(", azimuth ", ", Azimut ") +
        degreesText(shortNumber(*options.azimuth)));
    say(azimuthSentence());
}

void printIlluminance(RnNaturalLight& naturalLight, const SkyOptions& options) {
    const float illuminance = naturalLight.getSkyIlluminance(normalised(*options.normal).data());
    if (options.json) return printLine(Json{{"illuminance", illuminance}});
    say(shortNumber(illuminance) +
        inLanguage(" lux from the sky on a surface that faces ", " Lux vom Himmel auf eine Fläche in Richtung ") +
        shortNumber((*options.normal)[0]) + ", " + shortNumber((*options.normal)[1]) + ", " +
        shortNumber((*options.normal)[2]));
    say(inLanguage("Scene: x east, y north, z up, before north is turned.",
                   "Szene: x Osten, y Norden, z oben, bevor Norden gedreht ist."));
}

int runSky(const SkyOptions& options, const HostSession& session) {
    const auto naturalLight = makeDaylight(session, options.naturalLight, options.json);
    if (!naturalLight) return exitFailed;
    showOutOfRange(*naturalLight);
    options.normal ? printIlluminance(*naturalLight, options) : printLuminance(*naturalLight, options);
    return exitWell;
}

}  // namespace

Action declareSky(CLI::App& app) {
    auto options = std::make_shared<SkyOptions>();
    auto* zenith = addParsed(app, {"--zenith", "DEG", "Luminance at this angle from the zenith"}, parseZenith,
                             [options = options.get()](float value) { options->zenith = value; });
    auto* azimuth = addParsed(app, {"--azimuth", "DEG", "and this azimuth: 0 south, positive towards west"},
                              parseFloat, [options = options.get()](float value) { options->azimuth = value; });
    auto* normal = addParsed(
        app, {"--normal", "X,Y,Z", "Illuminance of a surface that faces this way: x east, y north, z up"},
        parseNormal, [options = options.get()](const Vector& value) { options->normal = value; });
    zenith->needs(azimuth);
    azimuth->needs(zenith);
    normal->excludes(zenith, azimuth);
    app.final_callback([options = options.get()] {
        if (!options->zenith && !options->normal) throw CLI::RequiredError("--zenith and --azimuth, or --normal");
    });
    addDaylightOptions(app, options->naturalLight);
    addJsonFlag(app, options->json);
    return [options](const HostSession& session) { return runSky(*options, session); };
}

}  // namespace OvTool
