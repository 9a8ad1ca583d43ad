#include <CLI/CLI.hpp>
#include <iostream>
#include <memory>
#include <optional>

#include "tools/numbers/numbers.h"
#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/fileAngles.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/standardStreams.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

using namespace Ov;

namespace {

struct IntensityOptions {
    std::string file;
    std::vector<std::string> directions;
    std::string frame = "file";
    std::optional<float> flux;
    std::string as;
    bool json = false;
};

/// Degrees: vertical and horizontal angle of the file, or theta and psi.
struct Direction {
    float first;
    float second;
};

constexpr std::string_view blanks = " \t\r";

std::string_view trimmed(std::string_view text) {
    const std::size_t first = text.find_first_not_of(blanks);
    if (first == std::string_view::npos) return {};
    return text.substr(first, text.find_last_not_of(blanks) - first + 1);
}

/// Two numbers with a comma or a blank between them.
std::optional<Direction> parseDirection(std::string_view text) {
    text = trimmed(text);
    const std::size_t end = text.find_first_of(", \t");
    if (end == std::string_view::npos) return {};
    std::string_view second = trimmed(text.substr(end));
    if (second.starts_with(',')) second = trimmed(second.substr(1));
    const auto one = parseFloat(text.substr(0, end));
    const auto other = parseFloat(second);
    if (!one || !other) return {};
    return Direction{*one, *other};
}

std::string checkDirection(std::string& text) {
    return parseDirection(text)
               ? ""
               : "'" + text + "' is no direction: two angles in degrees, such as 30,90, are wanted";
}

class IntensityPrinter {
public:
    IntensityPrinter(const IntensityOptions& options, const RnWebIntensityDist& light)
        : _frame(options.frame), _json(options.json), _light(light), _file(fileInfoOf(*light.getWeb())) {}

    /// Why there is no such direction; empty where there is.
    std::string fault(const Direction& direction) const {
        const double lowest = _frame == "file" ? -double{_file.verticalShift} : 0;
        if (direction.first >= lowest) return {};
        return exactNumber(direction.first) + " deg is below the axis, which is at " +
               exactNumber(static_cast<float>(lowest));
    }

    void print(const Direction& direction) const {
        const float candela = towards(direction);
        if (_json) {
            const bool ofFile = _frame == "file";
            printLine(Json{{ofFile ? "vertical" : "theta", direction.first},
                           {ofFile ? "horizontal" : "psi", direction.second},
                           {"candela", candela}});
        } else {
            say(padLeft(exactNumber(direction.first), 8) + " deg " + padLeft(exactNumber(direction.second), 8) +
                " deg " + padLeft(exactNumber(candela), 12) + " cd");
        }
    }

private:
    float towards(const Direction& direction) const {
        if (_frame == "file")
            return _light.localIntensity(_file.theta(direction.first), _file.psi(direction.second));
        const float theta = toRadians(direction.first);
        const float psi = toRadians(direction.second);
        return _frame == "host" ? _light.intensity(theta, psi) : _light.localIntensity(theta, psi);
    }

    std::string _frame;
    bool _json;
    const RnWebIntensityDist& _light;
    PhotoFileInfo _file;
};

/// Answers the directions of the lines of standard input. Lines that hold none are reported.
int answerInput(const IntensityPrinter& printer) {
    int status = exitWell;
    std::string line;
    for (int number = 1; std::cout && std::getline(std::cin, line); ++number) {
        const std::string_view text = trimmed(line);
        if (text.empty() || text.front() == '#') continue;
        const auto direction = parseDirection(text);
        const std::string fault = direction ? printer.fault(*direction) : "no direction (two angles in degrees)";
        if (fault.empty()) {
            printer.print(*direction);
        } else {
            complain("standard input, line " + std::to_string(number) + ": " + fault);
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
    const auto light = session.lightOf(*result.web);
    if (options.flux) {
        if (!(light->getFlux() > 0)) {
            complain(options.file + ": --flux cannot scale a flux that is not above 0");
            return exitFailed;
        }
        light->setFlux(*options.flux);
    }
    const IntensityPrinter printer(options, *light);
    if (options.directions.empty()) return answerInput(printer);
    for (const std::string& text : options.directions) {
        const std::string fault = printer.fault(*parseDirection(text));
        if (!fault.empty()) throw CLI::ValidationError("DIRECTION", "'" + text + "': " + fault);
    }
    for (const std::string& text : options.directions) printer.print(*parseDirection(text));
    return exitWell;
}

}  // namespace

Action declareIntensity(CLI::App& app) {
    auto options = std::make_shared<IntensityOptions>();
    app.add_option("FILE", options->file, "Photometric file, - for standard input")->required();
    app.add_option(
           "DIRECTION", options->directions,
           "Directions in degrees, vertical and horizontal angle or theta and psi: 30,90; without any, lines "
           "\"30 90\" from standard input")
        ->check(CLI::Validator(checkDirection, "", "direction"));
    app.add_option(
           "--frame", options->frame,
           "How directions count: as the vertical and horizontal angles of the file (the default), or as theta "
           "and psi of the host's frame or of the web's own")
        ->check(CLI::IsMember({"file", "host", "local"}).description(""))
        ->type_name("file|host|local");
    const auto setFlux = [options](const std::string& text) {
        options->flux = parseFloat(text);
        if (!options->flux || *options->flux < 0)
            throw CLI::ValidationError("--flux", "'" + text + "' is no flux");
    };
    app.add_option_function<std::string>(
           "--flux", setFlux,
           "Flux of the lamps in lumens, instead of the file's; of the luminaire where it names no lamps'")
        ->type_name("LM");
    app.callback([options] {
        if (options->directions.empty() && isStandardStream(options->file))
            throw CLI::RequiredError("DIRECTION, as standard input holds the file,");
    });
    addAsOption(app, options->as);
    addJsonFlag(app, options->json);
    return [options](const HostSession& session) {
        options->as = sourceFormat(session, options->as);
        return runIntensity(*options, session);
    };
}

}  // namespace OvTool
