#include <CLI/CLI.hpp>
#include <iostream>
#include <memory>
#include <optional>

#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/numbers.h"
#include "tools/ovphoto/standardStreams.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

using namespace Ov;

namespace {

struct IntensityOptions {
    std::string file;
    std::vector<std::string> directions;
    std::string frame = "local";
    std::optional<float> flux;
    std::string as;
    bool json = false;
};

/// Degrees.
struct Direction {
    float theta;
    float psi;
};

constexpr std::string_view blanks = " \t\r";

std::string_view trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

/// "theta,psi" or "theta psi".
std::optional<Direction> parseDirection(std::string_view text) {
    text = trimmed(text);
    const std::size_t end = text.find_first_of(", \t");
    if (end == std::string_view::npos) return {};
    std::string_view second = trimmed(text.substr(end));
    if (second.starts_with(',')) second = trimmed(second.substr(1));
    const auto theta = parseFloat(text.substr(0, end));
    const auto psi = parseFloat(second);
    if (!theta || !psi) return {};
    return Direction{*theta, *psi};
}

std::string checkDirection(std::string& text) {
    return parseDirection(text) ? "" : "'" + text + "' is no direction: theta,psi in degrees are wanted";
}

class IntensityPrinter {
public:
    IntensityPrinter(const IntensityOptions& options, const RnIntensityDist& light)
        : _host(options.frame == "host"), _json(options.json), _light(light) {}

    void print(const Direction& direction) const {
        const float theta = toRadians(direction.theta);
        const float psi = toRadians(direction.psi);
        const float candela = _host ? _light.intensity(theta, psi) : _light.localIntensity(theta, psi);
        if (_json) {
            printLine(Json{{"theta", direction.theta}, {"psi", direction.psi}, {"candela", candela}});
        } else {
            say(padLeft(exactNumber(direction.theta), 8) + " deg " + padLeft(exactNumber(direction.psi), 8) +
                " deg " + padLeft(exactNumber(candela), 12) + " cd");
        }
    }

private:
    bool _host;
    bool _json;
    const RnIntensityDist& _light;
};

/// Answers the directions of the lines of standard input. Lines that hold none are reported.
int answerInput(const IntensityPrinter& printer) {
    int status = exitWell;
    std::string line;
    for (int number = 1; std::cout && std::getline(std::cin, line); ++number) {
        const std::string_view text = trimmed(line);
        if (text.empty() || text.front() == '#') continue;
        if (const auto direction = parseDirection(text)) {
            printer.print(*direction);
        } else {
            complain("standard input, line " + std::to_string(number) + ": no direction (theta psi, in degrees)");
            status = exitFailed;
        }
    }
    if (!std::cin.bad()) return status;
    complain("standard input cannot be read");
    return exitFailed;
}

int runIntensity(const IntensityOptions& options, const HostSession& session) {
    const ReadResult result = session.read(options.file, options.as);
    showReasons(result);
    if (!result.web) {
        if (options.json) printRefusal(result);
        return exitFailed;
    }
    const auto light = session.distribute(*result.web, options.flux.value_or(result.web->getLumens()));
    const IntensityPrinter printer(options, *light);
    if (options.directions.empty()) return answerInput(printer);
    for (const std::string& text : options.directions) printer.print(*parseDirection(text));
    return exitWell;
}

}  // namespace

Action declareIntensity(CLI::App& app) {
    auto options = std::make_shared<IntensityOptions>();
    app.add_option("FILE", options->file, "Photometric file, - for standard input")->required();
    app.add_option("DIRECTION", options->directions,
                   "Directions theta,psi in degrees; without any, lines \"theta psi\" from standard input")
        ->check(CLI::Validator(checkDirection, "", "direction"));
    app.add_option("--frame", options->frame,
                   "Frame of the directions: local (the file's angles, the default) or host")
        ->check(CLI::IsMember({"local", "host"}).description(""))
        ->type_name("local|host");
    const auto setFlux = [options](const std::string& text) {
        options->flux = parseFloat(text);
        if (!options->flux || *options->flux < 0)
            throw CLI::ValidationError("--flux", "'" + text + "' is no flux");
    };
    app.add_option_function<std::string>("--flux", setFlux, "Total flux in lumens, instead of the file's")
        ->type_name("LM");
    app.callback([options] {
        if (options->directions.empty() && isStandardStream(options->file))
            throw CLI::RequiredError("DIRECTION, as standard input holds the file,");
    });
    addAsOption(app, options->as);
    addJsonFlag(app, options->json);
    return [options](const HostSession& session) { return runIntensity(*options, session); };
}

}  // namespace OvTool
