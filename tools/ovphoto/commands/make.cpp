#include <CLI/CLI.hpp>
#include <cmath>
#include <memory>

#include "ovphoto/classIds.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/commands/parsedOption.h"
#include "tools/ovphoto/luminaireFile.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

using namespace Ov;
namespace classIds = OvPhotometrics::classIds;

namespace {

// Angles that a spotlight can hold, in degrees from its axis.
constexpr float narrowest = 0.11F;
constexpr float widestHotspot = 89;
constexpr float widestFalloff = 90;
constexpr float usualHotspot = 30;
constexpr float usualFalloff = 60;
constexpr float usualFlux = 1000;  // lumens

struct MakeOptions {
    std::string kind;
    std::string out;
    std::string to;
    std::optional<float> candela;
    std::optional<float> flux;
    std::optional<float> hotspot;
    std::optional<float> falloff;
};

RnRef<RnIntensityDist> makeLight(const MakeOptions& options, const HostSession& session) {
    const RnUid& classId = options.kind == "isotropic" ? classIds::isotropic
                           : options.kind == "diffuse" ? classIds::diffuse
                                                       : classIds::spotlight;
    const auto object = session.manager().createObject(classId);
    if (!object) throw ExModule("the module builds no " + options.kind + " distribution");
    if (const auto spotlight = rnQuery<RnSpotlightIntensityDist>(object.get())) {
        if (options.hotspot) spotlight->setHotspotCosine(std::cos(toRadians(*options.hotspot)));
        if (options.falloff) spotlight->setFalloffCosine(std::cos(toRadians(*options.falloff)));
    }
    auto light = rnCast<RnIntensityDist>(object.get());
    if (options.candela) {
        light->setPeakIntensity(*options.candela);
    } else {
        light->setFlux(options.flux.value_or(usualFlux));
    }
    return light;
}

/// Writes the light; none, with the reasons, when there is no file then.
std::optional<LuminaireFile> writeLight(RnIntensityDist& light, const MakeOptions& options,
                                        const HostSession& session, const Format& target,
                                        std::vector<std::string>& reasons) {
    auto made = makeFile(session, options.out, target, light, FileForm::faithful, {}, reasons);
    if (!made) return {};
    const std::string error = made->light ? writeFile(options.out, made->bytes) : made->refusal;
    if (error.empty()) return made;
    reasons.push_back(error);
    return {};
}

int runMake(const MakeOptions& options, const HostSession& session) {
    const Format& target = targetFormat(session, options.to, options.out);
    const auto light = makeLight(options, session);
    std::vector<std::string> reasons;
    const auto made = writeLight(*light, options, session, target, reasons);
    showReasons(options.out, reasons);
    if (!made) return exitFailed;
    sayOf(options.out, options.out + ": " + options.kind + ", " + shortNumber(light->getPeakIntensity()) +
                           " cd, " + shortNumber(light->getFlux()) + " lm");
    const ConversionLoss loss = measureLoss(*light, *made->light);
    for (const std::string& warning : lossWarnings(loss, target, *light, *made))
        complain(options.out + ": warning: " + warning);
    return exitWell;
}

std::optional<float> parsePositive(const std::string& text) {
    const auto value = parseFloat(text);
    return value && *value > 0 ? value : std::nullopt;
}

/// Declares an option whose value is an angle from the axis.
void addAngle(CLI::App& app, const OptionText& text, float widest, std::optional<float>& angle) {
    const auto parse = [name = text.name, widest](const std::string& given) {
        const auto degrees = parseFloat(given);
        if (degrees && *degrees >= narrowest && *degrees <= widest) return degrees;
        throw CLI::ValidationError(name, "'" + given + "' is no angle from " + shortNumber(narrowest) + " to " +
                                             shortNumber(widest) + " degrees");
    };
    addParsed(app, text, parse, [&angle](float degrees) { angle = degrees; });
}

void addStrength(CLI::App& app, MakeOptions& options) {
    auto* candela = addParsed(app, {"--candela", "CD", "Peak intensity"}, parsePositive,
                              [&options](float value) { options.candela = value; });
    auto* flux = addParsed(app, {"--flux", "LM", "Total flux instead; 1000 lm when neither is given"},
                           parsePositive, [&options](float value) { options.flux = value; });
    candela->excludes(flux);
}

void addSpotlight(CLI::App& app, MakeOptions& options) {
    addAngle(app,
             {"--hotspot", "DEG",
              "Spotlight: angle from the axis, 0.11 to 89, where it is down to half; 30 when not given"},
             widestHotspot, options.hotspot);
    addAngle(app,
             {"--falloff", "DEG",
              "Spotlight: angle from the axis, 0.11 to 90, beyond which it is dark; 60 when not given"},
             widestFalloff, options.falloff);
}

/// What depends on more than one argument.
void checkArguments(MakeOptions& options) {
    if (options.kind != "spotlight" && (options.hotspot || options.falloff))
        throw CLI::ValidationError("--hotspot, --falloff", "only a spotlight has these angles");
    const float hotspot = options.hotspot.value_or(usualHotspot);
    const float falloff = options.falloff.value_or(usualFalloff);
    if (hotspot > falloff)
        throw CLI::ValidationError(
            "--hotspot", shortNumber(hotspot) + " degrees are more than the falloff's " + shortNumber(falloff));
}

}  // namespace

Action declareMake(CLI::App& app) {
    auto options = std::make_shared<MakeOptions>();
    app.add_option("KIND", options->kind, "isotropic, diffuse or spotlight")
        ->required()
        ->check(CLI::IsMember({"isotropic", "diffuse", "spotlight"}).description(""));
    app.add_option("OUT", options->out, "File to write")->required();
    addToOption(app, options->to);
    addStrength(app, *options);
    addSpotlight(app, *options);
    app.callback([options] { checkArguments(*options); });
    return [options](const HostSession& session) { return runMake(*options, session); };
}

}  // namespace OvTool
