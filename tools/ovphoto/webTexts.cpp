#include "tools/ovphoto/webTexts.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "components/support/path.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/fileAngles.h"

namespace OvTool {

using namespace Ov;

namespace {

std::string degreesText(double degrees) { return shortNumber(degrees) + " deg"; }

std::string meaningOf(PhotoWebSymmetry symmetry, const PhotoFileInfo& file) {
    const auto plane = [&](float psi) { return horizontalOf(file, toRadians(psi)); };
    switch (symmetry) {
        case PhotoWebSymmetry::Full:
            return "no symmetry";
        case PhotoWebSymmetry::Half:
            return "mirrored at the plane of horizontal " + shortNumber(plane(0)) +
                   (file.lateral ? "" : " and " + shortNumber(plane(180))) + " deg";
        case PhotoWebSymmetry::Quarter:
            return "mirrored at the planes of horizontal " + shortNumber(plane(0)) + " and " +
                   shortNumber(plane(90)) + " deg";
        case PhotoWebSymmetry::Axial:
            return "the same all around the axis";
    }
    return "unknown";
}

std::string rangeText(const std::vector<double>& angles) {
    const std::string count = std::to_string(angles.size()) + (angles.size() == 1 ? " angle" : " angles");
    if (angles.size() < 2) return angles.empty() ? count : count + ", " + degreesText(angles.front());
    return count + ", " + shortNumber(angles.front()) + " to " + degreesText(angles.back());
}

/// Where the first of the largest values stands.
std::string peakPlace(RnPhotoWebData& web) {
    int bestTheta = 0;
    int bestPsi = 0;
    for (int j = 0; j < web.getPsiCount(); ++j) {
        for (int i = 0; i < web.getThetaCount(); ++i) {
            if (web.getCandela(j, i) <= web.getCandela(bestPsi, bestTheta)) continue;
            bestTheta = i;
            bestPsi = j;
        }
    }
    const PhotoFileInfo file = fileInfoOf(web);
    return "vertical " + degreesText(verticalOf(file, web.getTheta(bestTheta))) + ", horizontal " +
           degreesText(horizontalOf(file, web.getPsi(bestPsi)));
}

std::string orientationText(RnPhotoWebData& web) {
    const GeLinearMatrix3<float> matrix = web.getOrientation();
    if (web.hasIdentityOrientation()) return "not turned: host and file share their frame";
    if (std::abs(matrix[8]) < 0.5F) return "turned: the poles lie in the host's horizontal plane";
    const auto turn = static_cast<float>(std::atan2(matrix[1], matrix[0]));  // of the host's psi 0
    const double angle = fileInfoOf(web).horizontal(turn);
    const double rounded = std::round(angle * 100) / 100 + 0.0;
    return "the host's psi 0 is horizontal " + degreesText(rounded < 0 ? rounded + 360 : rounded) + " of the file";
}

std::string luminaireText(RnPhotoWebData& web) {
    const auto ratio = outputRatio(web);
    return shortNumber(luminaireLumensOf(web)) + " lm" +
           (ratio ? ", " + fixedNumber(*ratio * 100, 1) + " % of the lamps'" : "");
}

}  // namespace

const char* symmetryName(PhotoWebSymmetry symmetry) {
    switch (symmetry) {
        case PhotoWebSymmetry::Full:
            return "Full";
        case PhotoWebSymmetry::Half:
            return "Half";
        case PhotoWebSymmetry::Quarter:
            return "Quarter";
        case PhotoWebSymmetry::Axial:
            return "Axial";
    }
    return "Unknown";
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

const char* unitName(PhotoValueUnit unit) { return unit == PhotoValueUnit::candela ? "cd" : "cd/klm"; }

float peakCandela(RnPhotoWebData& web) {
    return std::min(web.getMaxCandela() * fileInfoOf(web).candelaFactor, std::numeric_limits<float>::max());
}

std::optional<double> outputRatio(RnPhotoWebData& web) {
    const float lamps = fileInfoOf(web).lampLumens;
    return lamps > 0 ? std::optional(double{luminaireLumensOf(web)} / lamps) : std::nullopt;
}

std::vector<std::pair<std::string, std::string>> webTexts(const ReadResult& result) {
    RnPhotoWebData& web = *result.web;
    const PhotoFileInfo file = fileInfoOf(web);
    std::vector<std::pair<std::string, std::string>> texts{
        {"Format", result.format},
        {"Name", toUtf8(web.getName())},
        {"Symmetry", symmetryName(web.getSymmetry()) + (": " + meaningOf(web.getSymmetry(), file))},
        {"Vertical", rangeText(verticalsOf(web))},
        {"Horizontal", rangeText(horizontalsOf(web)) + (web.isPsiTruncated() ? ", dark beyond" : "")},
        {"Peak", shortNumber(peakCandela(web)) + " cd at " + peakPlace(web)}};
    if (file.lampLumens > 0) texts.emplace_back("Lamp flux", shortNumber(file.lampLumens) + " lm");
    texts.emplace_back("Luminaire flux", luminaireText(web));
    texts.emplace_back("Orientation", orientationText(web));
    for (const std::string& needed : filesOf(web)) texts.emplace_back("Needs file", needed);
    return texts;
}

}  // namespace OvTool
