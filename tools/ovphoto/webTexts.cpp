#include "tools/ovphoto/webTexts.h"

#include <cmath>
#include <numbers>

#include "host/platform/path.h"
#include "tools/ovphoto/numbers.h"

namespace OvTool {

using namespace Ov;

namespace {

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

}  // namespace

const char* symmetryName(PhotoWebSymmetry symmetry) { return symmetryText(symmetry).name; }

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

/// What the values of the file are; webs hold them as they stand there.
const char* unitOf(const ReadResult& result) {
    return result.format == "NIMB" || result.format == "TBT" ? "cd/klm" : "cd";
}

std::vector<std::pair<std::string, std::string>> webTexts(const ReadResult& result) {
    const RnPhotoWebData& web = *result.web;
    const SymmetryText symmetry = symmetryText(web.getSymmetry());
    std::vector<std::pair<std::string, std::string>> texts{
        {"Format", result.format},
        {"Name", toUtf8(web.getName())},
        {"Symmetry", std::string(symmetry.name) + ": " + symmetry.meaning},
        {"Vertical", rangeText(thetasOf(web))},
        {"Horizontal", rangeText(psisOf(web)) + (web.isPsiTruncated() ? ", dark beyond" : "")},
        {"Peak", shortNumber(web.getMaxCandela()) + " " + unitOf(result) + " at " + peakPlace(web)},
        {"Total flux", shortNumber(web.getLumens()) + " lm"},
        {"Orientation", orientationText(web)}};
    for (const std::string& file : filesOf(web)) texts.emplace_back("Needs file", file);
    return texts;
}

}  // namespace OvTool
