#include "tools/ovphoto/fileAngles.h"

#include "tools/numbers/numbers.h"

namespace OvTool {

using namespace Ov;

PhotoFileInfo fileInfoOf(RnPhotoWebData& web) {
    const auto file = rnQuery<RnPhotoFileWeb>(&web);
    return file ? file->getFileInfo() : PhotoFileInfo();
}

float luminaireLumensOf(RnPhotoWebData& web) {
    const auto file = rnQuery<RnPhotoFileWeb>(&web);
    return file ? file->getLuminaireLumens() : web.getLumens();
}

double verticalOf(const PhotoFileInfo& file, float theta) {
    if (file.verticalShift == 0) return toDegrees(theta);
    return shortestNear(file.vertical(theta), [&](float angle) { return file.theta(angle) == theta; });
}

double horizontalOf(const PhotoFileInfo& file, float psi) {
    if (file.horizontalShift == 0) return toDegrees(psi);
    return shortestNear(file.horizontal(psi), [&](float angle) { return file.psi(angle) == psi; });
}

std::vector<double> verticalsOf(RnPhotoWebData& web) {
    const PhotoFileInfo file = fileInfoOf(web);
    std::vector<double> angles;
    for (int i = 0; i < web.getThetaCount(); ++i) angles.push_back(verticalOf(file, web.getTheta(i)));
    return angles;
}

std::vector<double> horizontalsOf(RnPhotoWebData& web) {
    const PhotoFileInfo file = fileInfoOf(web);
    std::vector<double> angles;
    for (int j = 0; j < web.getPsiCount(); ++j) angles.push_back(horizontalOf(file, web.getPsi(j)));
    if (file.closingPlane != 0)
        angles.push_back(shortestNear(file.closingPlane, [&](float angle) { return angle == file.closingPlane; }));
    return angles;
}

}  // namespace OvTool
