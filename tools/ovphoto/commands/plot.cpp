#include <CLI/CLI.hpp>
#include <algorithm>
#include <charconv>
#include <memory>

#include "tools/numbers/numbers.h"
#include "tools/ovphoto/commands/parsedOption.h"
#include "tools/ovphoto/commands/pictureOptions.h"

namespace OvTool {

namespace {

constexpr int smallest = 100;  // pixels a side
constexpr int largest = 8000;
constexpr std::size_t mostFiles = 8;  // that one diagram tells apart
constexpr std::size_t mostPlanes = 8;

std::optional<PictureKind> parseKind(const std::string& text) {
    static constexpr std::pair<const char*, PictureKind> kinds[] = {{"polar", PictureKind::polar},
                                                                    {"cartesian", PictureKind::cartesian},
                                                                    {"cone", PictureKind::cone},
                                                                    {"isolux", PictureKind::isolux},
                                                                    {"solid", PictureKind::solid}};
    for (const auto& [name, kind] : kinds)
        if (text == name) return kind;
    return {};
}

std::optional<std::vector<double>> parsePlanes(std::string_view text) {
    std::vector<double> planes;
    for (std::size_t end = 0; end != std::string_view::npos; text.remove_prefix(std::min(end + 1, text.size()))) {
        end = text.find(',');
        const auto plane = parseFloat(text.substr(0, end));
        if (!plane || *plane < 0 || *plane >= 360 || planes.size() == mostPlanes) return {};
        planes.push_back(*plane);
        if (end == std::string_view::npos) break;
    }
    return planes;
}

struct Size {
    int width;
    int rows;
};

std::optional<int> parseSide(std::string_view text) {
    int side = 0;
    const char* const end = text.data() + text.size();
    const auto result = std::from_chars(text.data(), end, side);
    const bool whole = result.ec == std::errc() && result.ptr == end;
    return whole && side >= smallest && side <= largest ? std::optional(side) : std::nullopt;
}

std::optional<Size> parseSize(std::string_view text) {
    const std::size_t cross = text.find('x');
    if (cross == std::string_view::npos) return {};
    const auto width = parseSide(text.substr(0, cross));
    const auto rows = parseSide(text.substr(cross + 1));
    return width && rows ? std::optional(Size{*width, *rows}) : std::nullopt;
}

std::optional<float> parseHeight(std::string_view text) {
    const auto height = parseFloat(text);
    return height && *height >= 0.01F && *height <= 1000 ? height : std::nullopt;
}

bool isOfSky(PictureKind kind) { return kind == PictureKind::sky || kind == PictureKind::sunPath; }

bool showsOneFile(PictureKind kind) { return kind != PictureKind::polar && kind != PictureKind::cartesian; }

/// What depends on more than one argument.
void checkArguments(const PlotOptions& options) {
    const bool hasSite = !options.daylight.from.empty() || !options.daylight.changes.empty();
    if (isOfSky(options.kind)) {
        if (!options.files.empty()) throw CLI::ValidationError("FILE", "none is wanted with --sky and --sun-path");
        return;
    }
    if (options.files.empty()) throw CLI::RequiredError("FILE, --sky or --sun-path");
    if (hasSite) throw CLI::ValidationError("site, date, time and sky", "are for --sky and --sun-path");
    const std::size_t most = showsOneFile(options.kind) ? 1 : mostFiles;
    if (options.files.size() > most)
        throw CLI::ValidationError("FILE", most == 1 ? "a diagram of this kind shows one"
                                                     : "one diagram tells " + std::to_string(most) + " apart");
}

void addSkyFlag(CLI::App& app, PlotOptions& options, const char* name, PictureKind kind, const char* help,
                const std::vector<CLI::Option*>& others) {
    auto* flag = app.add_flag_callback(
        name, [&options, kind] { options.kind = kind; }, help);
    for (CLI::Option* other : others) flag->excludes(other);
}

}  // namespace

Action declarePlot(CLI::App& app) {
    auto shared = std::make_shared<PlotOptions>();
    PlotOptions& options = *shared;
    app.add_option("FILE", options.files,
                   "Photometric files, - for standard input; polar and cartesian diagrams show up to 8");
    app.add_option("-o,--out", options.out, "Picture to write: .svg, .png or .pdf, or - for standard output")
        ->required()
        ->type_name("OUT");
    auto* kind = addParsed(app, {"--kind", "KIND", "polar (default), cartesian, cone, isolux or solid"}, parseKind,
                           [&options](PictureKind value) { options.kind = value; });
    auto* planes =
        addParsed(app, {"--planes", "C,C...", "Planes C of polar and cartesian diagrams, degrees; default 0,90"},
                  parsePlanes, [&options](const std::vector<double>& value) { options.planes = value; });
    auto* height = addParsed(
        app,
        {"--height", "M", "Height over the plane (isolux, default 3) or farthest distance (cone, default 5), m"},
        parseHeight, [&options](float value) { options.height = value; });
    addParsed(app, {"--size", "WxH", "Width and height in pixels, 100 to 8000; default 600x600"}, parseSize,
              [&options](Size value) {
                  options.width = value.width;
                  options.rows = value.rows;
              });
    app.add_option("--format", options.format,
                   "Write svg, png or pdf, whatever OUT ends in; svg to standard output")
        ->type_name("FORMAT")
        ->transform(CLI::IsMember({"svg", "png", "pdf"}, CLI::ignore_case).description(""));
    app.add_flag("--dark", options.dark, "Light lines on dark paper");
    addSkyFlag(app, options, "--sky", PictureKind::sky, "The sky's luminance instead, as it stands over the site",
               {kind, planes, height});
    addSkyFlag(app, options, "--sun-path", PictureKind::sunPath,
               "The sun's paths over the site instead, on the 21st of each month",
               {kind, planes, height, app.get_option("--sky")});
    addAsOption(app, options.as);
    addDaylightOptions(app, options.daylight);
    app.final_callback([shared] { checkArguments(*shared); });
    return [shared](const HostSession& session) {
        shared->as = sourceFormat(session, shared->as);
        return runPlot(*shared, session);
    };
}

}  // namespace OvTool
