#include <CLI/CLI.hpp>
#include <cmath>
#include <memory>
#include <utility>

#include "components/support/path.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/beamAngles.h"
#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/fileAngles.h"
#include "tools/ovphoto/fileFacts.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/table.h"
#include "tools/ovphoto/terminal.h"
#include "tools/ovphoto/webTexts.h"

namespace OvTool {

using namespace Ov;

namespace {

struct InfoOptions {
    std::vector<std::string> files;
    std::string as;
    bool json = false;
    bool values = false;
};

Json valuesOf(const RnPhotoWebData& web) {
    Json rows = Json::array();
    for (int j = 0; j < web.getPsiCount(); ++j) {
        Json row = Json::array();
        for (int i = 0; i < web.getThetaCount(); ++i) row.push_back(web.getCandela(j, i));
        rows.push_back(std::move(row));
    }
    return rows;
}

void printJson(const ReadResult& result, bool withValues) {
    RnPhotoWebData& web = *result.web;
    const float lamps = fileInfoOf(web).lampLumens;
    const auto ratio = outputRatio(web);
    Json object{{"file", result.file},
                {"format", result.format},
                {"name", toUtf8(web.getName())},
                {"symmetry", symmetryName(web.getSymmetry())},
                {"thetas", thetasOf(web)},
                {"psis", psisOf(web)},
                {"verticals", verticalsOf(web)},
                {"horizontals", horizontalsOf(web)},
                {"maxCandela", peakCandela(web)},
                {"lumens", web.getLumens()},
                {"lampLumens", lamps > 0 ? Json(lamps) : Json()},
                {"luminaireLumens", luminaireLumensOf(web)},
                {"outputRatio", ratio ? Json(static_cast<float>(*ratio)) : Json()},
                {"identityOrientation", web.hasIdentityOrientation()},
                {"orientation", web.getOrientation().values()},
                {"psiTruncated", web.isPsiTruncated()},
                {"files", filesOf(web)},
                {"unit", "cd"},
                {"fileUnit", unitName(result.reader->traits.unit)},
                {"facts", factsToJson(result.facts)}};
    if (withValues) object["values"] = valuesOf(web);
    printLine(object);
}

void printBeamAngles(const RnWebIntensityDist& light) {
    const auto angleText = [](const std::optional<OvPlot::AngleSpan>& angle) {
        return padLeft(angle ? shortNumber(std::round(angle->width() * 10) / 10) + " deg" : "-", 9);
    };
    Table table;
    table.add(
        {mainFrame(*light.getWeb()).aimed ? "Plane through the axis" : "Plane", "beam, 50 %", "field, 10 %"});
    for (const BeamAngles& angles : beamAngles(light)) {
        table.add({angles.plane, " " + angleText(angles.beam), "  " + angleText(angles.field)});
    }
    table.print(2);
}

void printFacts(const std::vector<Fact>& facts) {
    if (facts.empty()) return;
    say("  In the file");
    Table table;
    for (const Fact& fact : facts) table.add({toUtf8(fact.key), toUtf8(fact.text)});
    table.print(4);
}

void printText(const ReadResult& result, const HostSession& session) {
    Table table;
    for (const auto& [name, text] : webTexts(result)) table.add({name, text});
    say(result.file);
    table.print(2);
    printBeamAngles(*session.lightOf(*result.web));
    printFacts(result.facts);
}

int runInfo(const InfoOptions& options, const HostSession& session) {
    int status = exitWell;
    bool separated = false;
    for (const std::string& file : options.files) {
        if (!std::cout) break;
        const ReadResult result = session.read(file, options.as);
        showReasons(result);
        if (!result.web) {
            status = exitFailed;
            if (options.json) printRefusal(result);
        } else if (options.json) {
            printJson(result, options.values);
        } else {
            if (std::exchange(separated, true)) say("");
            printText(result, session);
        }
    }
    return status;
}

}  // namespace

Action declareInfo(CLI::App& app) {
    auto options = std::make_shared<InfoOptions>();
    app.add_option("FILE", options->files, "Photometric files, - for standard input")->required();
    addAsOption(app, options->as);
    addJsonFlag(app, options->json);
    app.add_flag("--values", options->values, "Print the relative values too, a row for each psi (JSON only)")
        ->needs("--json");
    return [options](const HostSession& session) {
        options->as = sourceFormat(session, options->as);
        return runInfo(*options, session);
    };
}

}  // namespace OvTool
