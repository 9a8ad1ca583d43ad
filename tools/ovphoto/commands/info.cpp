#include <CLI/CLI.hpp>
#include <cmath>
#include <iostream>
#include <memory>
#include <numbers>

#include "host/platform/path.h"
#include "tools/ovphoto/beamAngles.h"
#include "tools/ovphoto/commands/commands.h"
#include "tools/ovphoto/fileFacts.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/numbers.h"
#include "tools/ovphoto/table.h"

namespace OvTool {

using namespace Ov;

namespace {

struct InfoOptions {
    std::vector<std::string> files;
    std::string as;
    bool json = false;
    bool values = false;
};

struct SymmetryText {
    const char* name;
    const char* meaning;
};

SymmetryText symmetryText(PhotoWebSymmetry symmetry) {
    switch (symmetry) {
        case PhotoWebSymmetry::Full:
            return {"Full", "no symmetry"};
        case PhotoWebSymmetry::Half:
            return {"Half", "mirrored at the plane of psi 0 and 180 deg"};
        case PhotoWebSymmetry::Quarter:
            return {"Quarter", "mirrored at the planes of psi 0 and 90 deg"};
        case PhotoWebSymmetry::Axial:
            return {"Axial", "the same all around the axis"};
    }
    return {"Unknown", "unknown"};
}

std::vector<double> thetasOf(const RnPhotoWebData& web) {
    std::vector<double> angles;
    for (int i = 0; i < web.getThetaCount(); ++i) angles.push_back(toDegrees(web.getTheta(i)));
    return angles;
}

std::vector<double> psisOf(const RnPhotoWebData& web) {
    std::vector<double> angles;
    for (int j = 0; j < web.getPsiCount(); ++j) angles.push_back(toDegrees(web.getPsi(j)));
    return angles;
}

std::vector<std::string> filesOf(const RnPhotoWebData& web) {
    std::vector<std::string> files;
    auto collect = rnVisitor<const wchar_t*>([&files](const wchar_t* file) { files.push_back(toUtf8(file)); });
    web.enumerateFiles(collect);
    return files;
}

Json valuesOf(const RnPhotoWebData& web) {
    Json rows = Json::array();
    for (int j = 0; j < web.getPsiCount(); ++j) {
        Json row = Json::array();
        for (int i = 0; i < web.getThetaCount(); ++i) row.push_back(web.getCandela(j, i));
        rows.push_back(std::move(row));
    }
    return rows;
}

/// What the values of the file are; webs hold them as they stand there.
const char* unitOf(const ReadResult& result) {
    return result.format == "NIMB" || result.format == "TBT" ? "cd/klm" : "cd";
}

void printJson(const ReadResult& result, bool withValues) {
    const RnPhotoWebData& web = *result.web;
    Json object{{"file", result.file},
                {"format", result.format},
                {"name", toUtf8(web.getName())},
                {"symmetry", symmetryText(web.getSymmetry()).name},
                {"thetas", thetasOf(web)},
                {"psis", psisOf(web)},
                {"maxCandela", web.getMaxCandela()},
                {"lumens", web.getLumens()},
                {"identityOrientation", web.hasIdentityOrientation()},
                {"orientation", web.getOrientation().values()},
                {"psiTruncated", web.isPsiTruncated()},
                {"files", filesOf(web)},
                {"unit", unitOf(result)},
                {"facts", factsToJson(result.facts)}};
    if (withValues) object["values"] = valuesOf(web);
    printLine(object);
}

std::string degreesText(double degrees) { return shortNumber(degrees) + " deg"; }

std::string rangeText(const std::vector<double>& angles) {
    const std::string count = std::to_string(angles.size()) + (angles.size() == 1 ? " angle" : " angles");
    if (angles.size() < 2) return angles.empty() ? count : count + ", " + degreesText(angles.front());
    return count + ", " + shortNumber(angles.front()) + " to " + degreesText(angles.back());
}

/// Where the first of the largest values stands.
std::string peakPlace(const RnPhotoWebData& web) {
    int bestTheta = 0;
    int bestPsi = 0;
    for (int j = 0; j < web.getPsiCount(); ++j) {
        for (int i = 0; i < web.getThetaCount(); ++i) {
            if (web.getCandela(j, i) <= web.getCandela(bestPsi, bestTheta)) continue;
            bestTheta = i;
            bestPsi = j;
        }
    }
    return "theta " + degreesText(toDegrees(web.getTheta(bestTheta))) + ", psi " +
           degreesText(toDegrees(web.getPsi(bestPsi)));
}

std::string orientationText(const RnPhotoWebData& web) {
    const GeLinearMatrix3<float> matrix = web.getOrientation();
    if (web.hasIdentityOrientation()) return "not turned: host and file share their frame";
    if (std::abs(matrix[8]) < 0.5F) return "turned: the poles lie in the host's horizontal plane";
    const double turn = std::round(std::atan2(matrix[1], matrix[0]) * 18000 / std::numbers::pi) / 100;
    return "turned about the axis: the host's psi 0 is psi " + degreesText(turn < 0 ? turn + 360 : turn) + " here";
}

void printBeamAngles(const RnPhotoWebData& web, const RnWebIntensityDist& light) {
    const auto angleText = [](const std::optional<OvPlot::AngleSpan>& angle) {
        return padLeft(angle ? shortNumber(std::round(angle->width() * 10) / 10) + " deg" : "-", 9);
    };
    Table table;
    table.add({web.isPsiTruncated() ? "Plane through the axis" : "Plane", "beam, 50 %", "field, 10 %"});
    for (const BeamAngles& angles : beamAngles(light)) {
        table.add({angles.plane, " " + angleText(angles.beam), "  " + angleText(angles.field)});
    }
    table.print(2);
}

void printFacts(const std::vector<Fact>& facts) {
    if (facts.empty()) return;
    std::cout << "  In the file\n";
    Table table;
    for (const Fact& fact : facts) table.add({toUtf8(fact.key), toUtf8(fact.text)});
    table.print(4);
}

void printText(const ReadResult& result, const HostSession& session) {
    const RnPhotoWebData& web = *result.web;
    const SymmetryText symmetry = symmetryText(web.getSymmetry());
    Table table;
    table.add({"Format", result.format});
    table.add({"Name", toUtf8(web.getName())});
    table.add({"Symmetry", std::string(symmetry.name) + ": " + symmetry.meaning});
    table.add({"Vertical", rangeText(thetasOf(web))});
    table.add({"Horizontal", rangeText(psisOf(web)) + (web.isPsiTruncated() ? ", dark beyond" : "")});
    table.add({"Peak", shortNumber(web.getMaxCandela()) + " " + unitOf(result) + " at " + peakPlace(web)});
    table.add({"Total flux", shortNumber(web.getLumens()) + " lm"});
    table.add({"Orientation", orientationText(web)});
    for (const std::string& file : filesOf(web)) table.add({"Needs file", file});
    std::cout << result.file << '\n';
    table.print(2);
    printBeamAngles(web, *session.distribute(*result.web, web.getLumens()));
    printFacts(result.facts);
}

int runInfo(const InfoOptions& options, const HostSession& session) {
    int status = exitWell;
    const char* separator = "";
    for (const std::string& file : options.files) {
        const ReadResult result = session.read(file, options.as);
        showReasons(result);
        if (!result.web) {
            status = exitFailed;
            if (options.json) printRefusal(result);
        } else if (options.json) {
            printJson(result, options.values);
        } else {
            std::cout << separator;
            printText(result, session);
            separator = "\n";
        }
    }
    return status;
}

}  // namespace

Action declareInfo(CLI::App& app) {
    auto options = std::make_shared<InfoOptions>();
    app.add_option("FILE", options->files, "Photometric files")->required();
    addAsOption(app, options->as);
    addJsonFlag(app, options->json);
    app.add_flag("--values", options->values, "Print the relative values too, a row for each psi (JSON only)")
        ->needs("--json");
    return [options](const HostSession& session) { return runInfo(*options, session); };
}

}  // namespace OvTool
