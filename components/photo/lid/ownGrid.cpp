#include "components/photo/lid/ownGrid.h"

#include <algorithm>
#include <cmath>
#include <optional>

#include "components/photo/lid/gridLayout.h"
#include "components/photo/lid/sampling.h"
#include "components/photo/lid/webDistribution.h"

namespace OvPhotometrics {

namespace {

constexpr float fullCircle = 360;

/// A web's angles in degrees, each the multiple of 0.01 that it lies within 0.0005 of.
struct WrittenAngles {
    std::vector<float> thetas;
    std::vector<float> psis;
};

std::optional<std::vector<float>> asWritten(int count, auto angleAt) {
    std::vector<float> angles;
    for (int k = 0; k < count; ++k) {
        const double degrees = inDegrees(angleAt(k));
        const double rounded = std::round(degrees * 100) / 100;
        if (!(std::fabs(degrees - rounded) <= 0.0005)) return {};
        angles.push_back(static_cast<float>(rounded + 0.0));  // without a negative zero
    }
    return angles;
}

std::optional<WrittenAngles> asWritten(const Ov::RnPhotoWebData& web) {
    auto thetas = asWritten(web.getThetaCount(), [&](int i) { return web.getTheta(i); });
    auto psis = asWritten(web.getPsiCount(), [&](int j) { return web.getPsi(j); });
    if (!thetas || !psis || thetas->size() < 2 || psis->empty()) return {};
    return WrittenAngles{std::move(*thetas), std::move(*psis)};
}

/// How the file's angles come about: those of the web less what the format's reader adds.
struct Placement {
    GridFrame frame;
    float verticalShift;
    float horizontalShift;
};

/// What a reader of planes through the vertical axis adds to the horizontal angles, if it can give this web.
std::optional<float> polarShift(const Ov::RnPhotoWebData& web, float last, const OwnGridRules& rules) {
    const auto about = [&](float a, float b) { return std::fabs(a - b) <= rules.tolerance; };
    const PhotoWebSymmetry symmetry = web.getSymmetry();
    const bool half = symmetry == PhotoWebSymmetry::Half && about(last, 180);
    const bool full = symmetry == PhotoWebSymmetry::Full && last <= fullCircle;
    if (symmetry == PhotoWebSymmetry::Axial && std::fabs(web.getOrientation()[8] - 1) < 1e-6f) return 0.0f;
    if (!half && !full && !(symmetry == PhotoWebSymmetry::Quarter && about(last, 90))) return {};
    if (web.hasIdentityOrientation() || isTurned(web, turnedBy(0))) return 0.0f;
    if (half && isTurned(web, turnedBy(-90))) return -90.0f;
    if ((half || full) && rules.wraps && isTurned(web, turnedBy(-270))) return -270.0f;
    return {};
}

std::optional<Placement> polarPlacement(const Ov::RnPhotoWebData& web, const WrittenAngles& angles,
                                        const OwnGridRules& rules) {
    const auto about = [&](float a, float b) { return std::fabs(a - b) <= rules.tolerance; };
    const float first = angles.thetas.front();
    const float last = angles.thetas.back();
    const bool inRange =
        (about(first, 0) && (about(last, 90) || about(last, 180))) || (about(first, 90) && about(last, 180));
    if (web.isPsiTruncated() || !inRange) return {};
    const auto shift = polarShift(web, angles.psis.back(), rules);
    return shift ? std::optional(Placement{GridFrame::polar, 0, *shift}) : std::nullopt;
}

/// The multiple of 0.01 degree that an orientation turns by: from the sine and cosine of the angle.
float turnOf(double sine, double cosine) {
    return static_cast<float>(std::round(inDegrees(std::atan2(sine, cosine)) * 100) / 100);
}

std::optional<Placement> lateralPlacement(const Ov::RnPhotoWebData& web, const WrittenAngles& angles,
                                          const OwnGridRules& rules) {
    const float last = angles.psis.back();
    if (web.isPsiTruncated() != rules.lateralTruncated || angles.psis.size() < 2) return {};
    if (web.getSymmetry() == PhotoWebSymmetry::Half && last <= 90 && web.hasIdentityOrientation())
        return Placement{GridFrame::upright, 90, 0};
    if (web.getSymmetry() != PhotoWebSymmetry::Full) return {};

    const auto fits = [&](float shift) { return shift > rules.tolerance && shift <= 90 && last - shift <= 90; };
    const auto orientation = web.getOrientation();
    const float upright = turnOf(orientation[1], orientation[0]);
    if (rules.uprightTurned && fits(upright) && isTurned(web, turnedBy(upright)))
        return Placement{GridFrame::upright, 90, upright};
    const float laidDown = turnOf(-orientation[3], orientation[4]) - 90;
    if (fits(laidDown) && isTurned(web, laidDownBy(laidDown))) return Placement{GridFrame::laidDown, 90, laidDown};
    return {};
}

bool sameColumn(const Ov::RnPhotoWebData& web, int a, int b) {
    for (int i = 0; i < web.getThetaCount(); ++i)
        if (web.getCandela(a, i) != web.getCandela(b, i)) return false;
    return true;
}

void copyCandelas(CandelaGrid& grid, const Ov::RnPhotoWebData& web, float factor) {
    grid.candelas.reserve(grid.horizontalAngles.size() * grid.verticalAngles.size());
    for (int j = 0; j < grid.horizontalCount; ++j)
        for (int i = 0; i < grid.verticalCount; ++i) grid.candelas.push_back(web.getCandela(j, i) * factor);
}

}  // namespace

bool isTurned(const Ov::RnPhotoWebData& web, const GeLinearMatrix3<float>& turned) {
    const auto expected = turned.computeTranspose();
    const auto orientation = web.getOrientation();
    return std::equal(expected.values().begin(), expected.values().end(), orientation.values().begin(),
                      [](float a, float b) { return std::fabs(a - b) < 1e-5f; });
}

bool ownGrid(Ov::RnIntensityDist& dist, const OwnGridRules& rules, FileGrid& out) {
    const auto web = webOf(dist);
    const auto angles = web ? asWritten(*web) : std::nullopt;
    if (!angles || std::fabs(angles->psis.front()) > rules.tolerance) return false;
    auto placement = polarPlacement(*web, *angles, rules);
    if (!placement) placement = lateralPlacement(*web, *angles, rules);
    if (!placement) return false;

    CandelaGrid grid;
    const auto shiftedBack = [](float angle, float shift) {
        const double shifted = static_cast<double>(angle) - shift;
        return static_cast<float>(shift < -180 && shifted >= fullCircle ? shifted - fullCircle : shifted);
    };
    for (const float theta : angles->thetas)
        grid.verticalAngles.push_back(shiftedBack(theta, placement->verticalShift));
    for (const float psi : angles->psis)
        grid.horizontalAngles.push_back(shiftedBack(psi, placement->horizontalShift));
    if (placement->frame == GridFrame::polar && web->getSymmetry() == PhotoWebSymmetry::Full) {
        // The candela of the plane behind the last is that of plane 0.
        if (angles->psis.back() < fullCircle)
            grid.horizontalAngles.push_back(shiftedBack(fullCircle, placement->horizontalShift));
        else if (!sameColumn(*web, 0, web->getPsiCount() - 1))
            return false;
    }
    grid.verticalCount = static_cast<std::int32_t>(grid.verticalAngles.size());
    grid.horizontalCount = static_cast<std::int32_t>(grid.horizontalAngles.size());
    copyCandelas(grid, *web, dist.getPeakIntensity());
    out = {std::move(grid), placement->frame};
    return true;
}

FileGrid faithfulGrid(Ov::RnIntensityDist& dist, const OwnGridRules& rules) {
    FileGrid file;
    if (!ownGrid(dist, rules, file)) file = {sampledGrid(dist, planSampling(dist)), GridFrame::polar};
    return file;
}

float scaleForFile(CandelaGrid& grid, double unit) {
    constexpr double leastPeak = 2000;  // so that half of the last decimal is less than 5e-6 of the peak
    double peak = 0;
    for (const float candela : grid.candelas) peak = std::max(peak, candela * unit);
    double power = 1;
    while (peak > 0 && peak * power < leastPeak) power *= 10;
    for (float& candela : grid.candelas) candela = static_cast<float>(candela * unit * power);
    return static_cast<float>(1 / (unit * power));
}

}  // namespace OvPhotometrics
