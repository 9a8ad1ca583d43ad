#include <CLI/CLI.hpp>
#include <algorithm>
#include <numbers>

#include "components/support/path.h"
#include "plot/picture.h"
#include "plot/skyDiagram.h"
#include "tools/ovphoto/commands/pictureOptions.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/outputFile.h"
#include "tools/ovphoto/pictures/drawnFile.h"
#include "tools/ovphoto/placeAndTime.h"
#include "tools/ovphoto/standardStreams.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

namespace {

using OvPlot::Canvas;
using OvPlot::PictureFormat;

std::optional<PictureFormat> formatOf(const PlotOptions& options) {
    static constexpr std::pair<const char*, PictureFormat> endings[] = {
        {".svg", PictureFormat::svg}, {".png", PictureFormat::png}, {".pdf", PictureFormat::pdf}};
    const std::string path = !options.format.empty()         ? "." + options.format
                             : isStandardStream(options.out) ? ".svg"
                                                             : CLI::detail::to_lower(options.out);
    for (const auto& [ending, format] : endings)
        if (path.ends_with(ending)) return format;
    return {};
}

void (*drawerOf(PictureKind kind))(Canvas&, const OvPlot::Diagram&) {
    switch (kind) {
        case PictureKind::cartesian:
            return OvPlot::drawCartesian;
        case PictureKind::cone:
            return OvPlot::drawCone;
        case PictureKind::isolux:
            return OvPlot::drawIsolux;
        case PictureKind::solid:
            return OvPlot::drawSolid;
        default:
            return OvPlot::drawPolar;
    }
}

/// The files' lights; none, after their reasons, when one is refused.
std::optional<std::vector<DrawnFile>> readAll(const PlotOptions& options, const HostSession& session) {
    std::vector<DrawnFile> files;
    for (const std::string& path : options.files) {
        ReadResult result = session.read(path, options.as);
        showReasons(result);
        if (auto file = drawnFile(session, result)) files.push_back(std::move(*file));
    }
    return files.size() == options.files.size() ? std::optional(std::move(files)) : std::nullopt;
}

int write(const PlotOptions& options, PictureFormat format, const std::string& title,
          const std::function<void(Canvas&)>& draw) {
    const std::string bytes =
        OvPlot::drawPicture(format, {options.width, options.rows},
                            options.dark ? OvPlot::darkPalette() : OvPlot::lightPalette(), title, draw);
    const std::string error = writeFile(options.out, bytes);
    if (error.empty()) return exitWell;
    complain(options.out + ": " + error);
    return exitFailed;
}

int plotLights(const PlotOptions& options, PictureFormat format, const HostSession& session) {
    const auto files = readAll(options, session);
    if (!files) return exitFailed;
    OvPlot::Diagram diagram = diagramOf(*files);
    diagram.planes = options.planes;
    diagram.height = options.height;
    return write(options, format, diagram.title, [&](Canvas& canvas) { drawerOf(options.kind)(canvas, diagram); });
}

std::string angleText(float radians) { return fixedNumber(radians * 180 / std::numbers::pi, 1) + "\u00b0"; }

OvPlot::SkyCaption captionOf(Ov::RnNaturalLight& naturalLight,
                             const OvPhotometrics::NumberedFunctions& functions) {
    naturalLight.getSolarTime();  // where it was given, the local time follows from it
    OvPlot::SkyCaption caption;
    caption.subtitle = latitudeText(naturalLight.getLatitude()) + ", " +
                       longitudeText(naturalLight.getLongitude()) + "; " + dateText(naturalLight, functions) +
                       "; " + clockText(functions, naturalLight.getLocalTime()) + ", " +
                       utcText(functions, naturalLight.getTimeZoneHours()) +
                       (naturalLight.getDaylightSaving() ? inLanguage(", daylight saving", ", Sommerzeit") : "");
    const float altitude = naturalLight.getSolarAltitude();
    caption.notes = {altitude > 0 ? inLanguage("Sun ", "Sonne ") + angleText(altitude) +
                                        inLanguage(" high, azimuth ", " hoch, Azimut ") +
                                        angleText(naturalLight.getSolarAzimuth()) +
                                        inLanguage(" from south to west", " von Süden nach Westen")
                                  : inLanguage("The sun is ", "Die Sonne steht ") + angleText(-altitude) +
                                        inLanguage(" below the horizon", " unter dem Horizont")};
    caption.words = {inLanguage("E", "O"),
                     inLanguage(" to ", " bis "),
                     inLanguage("hours of the clock", "Stunden der Uhr"),
                     inLanguage("the set day", "der gewählte Tag"),
                     inLanguage("no light from the sky", "kein Licht vom Himmel"),
                     inLanguage(" ", ". ")};
    return caption;
}

int plotSky(const PlotOptions& options, PictureFormat format, Ov::RnNaturalLight& naturalLight,
            const OvPhotometrics::NumberedFunctions& functions) {
    OvPlot::SkyCaption caption = captionOf(naturalLight, functions);
    caption.title = inLanguage("Luminance of the ", "Leuchtdichte des Himmels, ") +
                    std::string(skyText(naturalLight.getSkyCover())) + inLanguage(" sky", "");
    caption.subtitle += inLanguage("; looking up", "; Blick nach oben");
    caption.notes.push_back(inLanguage("Zenith ", "Zenit ") + shortNumber(naturalLight.getZenithLuminance()) +
                            " cd/m\u00b2");
    caption.notes.push_back(inLanguage("Skylight on the ground ", "Himmelslicht am Boden ") +
                            fixedNumber(naturalLight.getSkyHorizontalIlluminance(), 0) + " lx");
    return write(options, format, caption.title,
                 [&](Canvas& canvas) { OvPlot::drawSky(canvas, naturalLight, caption); });
}

int plotSunPath(const PlotOptions& options, PictureFormat format, Ov::RnNaturalLight& naturalLight,
                const OvPhotometrics::NumberedFunctions& functions) {
    OvPlot::SkyCaption caption = captionOf(naturalLight, functions);
    caption.title = inLanguage("Paths of the sun", "Wege der Sonne");
    std::array<std::string, 12> months;
    for (std::size_t i = 0; i < months.size(); ++i)
        months[i] = Ov::toUtf8(functions.getMonthShortName(static_cast<int>(i) + 1));
    return write(options, format, caption.title,
                 [&](Canvas& canvas) { OvPlot::drawSunPath(canvas, naturalLight, caption, months); });
}

int plotNaturalLight(const PlotOptions& options, PictureFormat format, const HostSession& session) {
    const auto naturalLight = makeDaylight(session, options.daylight, false);
    if (!naturalLight) return exitFailed;
    showOutOfRange(*naturalLight);
    return (options.kind == PictureKind::sky ? plotSky : plotSunPath)(options, format, *naturalLight,
                                                                      session.functions());
}

}  // namespace

int runPlot(const PlotOptions& options, const HostSession& session) {
    const auto format = formatOf(options);
    if (!format) {
        complain(options.out + ": does not end in .svg, .png or .pdf");
        return exitUsage;
    }
    InputFiles inputs(options.files);
    inputs.add(options.daylight.from);
    const std::string refusal = inputs.refusal(options.out);
    if (!refusal.empty()) {
        complain(options.out + ": " + refusal);
        return exitFailed;
    }
    const bool ofSky = options.kind == PictureKind::sky || options.kind == PictureKind::sunPath;
    return (ofSky ? plotNaturalLight : plotLights)(options, *format, session);
}

}  // namespace OvTool
