#include "components/photo/files/ownGrid.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <optional>

#include "components/photo/files/gridLayout.h"
#include "components/photo/files/sampling.h"
#include "components/photo/files/webDistribution.h"

namespace OvPhotometrics {

namespace {

constexpr double fullCircle = 360;
constexpr double rimStep = 0.001;  // degrees between the angles that lead into the dark
constexpr int rimSteps = 3;
constexpr int dark = std::numeric_limits<int>::min();

/// An angle of the file, in degrees, and the index of the web's values there, or `dark`.
struct Node {
    double angle;
    int index;
};
using Nodes = std::vector<Node>;

struct Layout {
    GridFrame frame;
    Nodes vertical = {};
    Nodes horizontal = {};
};

/// The angle that a reader which adds `added` degrees takes as `radians`.
double fileAngle(float radians, double added) {
    const double degrees = inDegrees(radians) - added;
    for (int unit = 1; unit <= 10'000'000; unit *= 10) {
        const auto angle = static_cast<float>(std::round(degrees * unit) / unit);
        if (toRadians(angle + added) == radians) return angle + 0.0;  // without a negative zero
    }
    return static_cast<float>(degrees);
}

Nodes thetaNodes(const Ov::RnPhotoWebData& web, double added) {
    Nodes nodes;
    for (int i = 0; i < web.getThetaCount(); ++i) nodes.push_back({fileAngle(web.getTheta(i), added), i});
    return nodes;
}

/// Planes from 270 run on through 0.
Nodes psiNodes(const Ov::RnPhotoWebData& web, double added) {
    Nodes nodes;
    for (int j = 0; j < web.getPsiCount(); ++j) {
        double angle = fileAngle(web.getPsi(j), added);
        if (added < -180 && angle >= fullCircle) angle = fileAngle(web.getPsi(j), added + fullCircle);
        nodes.push_back({angle, j});
    }
    return nodes;
}

/// Leads behind the last angle into the dark, up to `limit`. `beyond` is the index that the web's own interpolation
/// takes there: with its values next to the rim what is before the rim stays as it is, and two dark angles keep what
/// is behind them dark. False without room.
bool addRimAbove(Nodes& nodes, int beyond, double limit) {
    const double rim = std::min(nodes.back().angle, limit - rimSteps * rimStep);
    if (nodes.size() < 2 || rim <= nodes[nodes.size() - 2].angle) return false;
    nodes.back().angle = rim;
    nodes.push_back({rim + rimStep, beyond});
    for (int k = 2; k <= rimSteps; ++k) nodes.push_back({rim + k * rimStep, dark});
    if (nodes.back().angle < limit - rimStep) nodes.push_back({limit, dark});
    return true;
}

/// The same before the first angle.
bool addRimBelow(Nodes& nodes, int beyond, double limit) {
    const auto mirror = [](Nodes& all) {
        std::reverse(all.begin(), all.end());
        for (Node& node : all) node.angle = -node.angle;
    };
    mirror(nodes);
    const bool added = addRimAbove(nodes, beyond, -limit);
    mirror(nodes);
    return added;
}

/// The turn of about so many degrees by which `matrixOf` gives the web's orientation: that of its file, else with
/// as few decimals as will do.
std::optional<float> turnOf(const Ov::RnPhotoWebData& web, double degrees, auto matrixOf) {
    if (const auto* const own = dynamic_cast<const RnBasePhotoWebData*>(&web))
        if (const float turn = own->getFileInfo().horizontalShift; isTurned(web, matrixOf(turn), 2e-7f))
            return turn;
    for (int unit = 1; unit <= 100'000; unit *= 10) {
        const auto turn = static_cast<float>(std::round(degrees * unit) / unit);
        if (isTurned(web, matrixOf(turn), 2e-7f)) return turn;
    }
    const auto turn = static_cast<float>(degrees);
    return isTurned(web, matrixOf(turn)) ? std::optional(turn) : std::nullopt;
}

std::optional<float> uprightTurn(const Ov::RnPhotoWebData& web) {
    const auto orientation = web.getOrientation();
    return turnOf(web, inDegrees(std::atan2(double{orientation[1]}, double{orientation[0]})), turnedBy);
}

std::optional<float> laidDownTurn(const Ov::RnPhotoWebData& web) {
    const auto orientation = web.getOrientation();
    return turnOf(web, inDegrees(std::atan2(-double{orientation[3]}, double{orientation[4]})) - 90,
                  [](float degrees) { return laidDownBy(degrees); });
}

/// Makes vertical angles start at 0 or 90 and end at 90 or 180 degrees.
bool reachEnds(Nodes& nodes, float tolerance) {
    const double first = nodes.front().angle;
    const double last = nodes.back().angle;
    const double end = last <= 90 + tolerance ? 90 : 180;
    const double start = first >= 90 - tolerance && end == 180 ? 90 : 0;
    return (first - start <= tolerance || addRimBelow(nodes, nodes.front().index, start)) &&
           (end - last <= tolerance || addRimAbove(nodes, nodes.back().index, end));
}

/// What a reader of planes through the vertical axis adds to the horizontal angles, if it can give this web.
std::optional<float> polarShift(const Ov::RnPhotoWebData& web, const OwnGridRules& rules) {
    const double last = inDegrees(web.getPsiRange().last);
    const auto endsAt = [&](double angle) { return std::fabs(last - angle) <= rules.tolerance; };
    const PhotoWebSymmetry symmetry = web.getSymmetry();
    if (symmetry == PhotoWebSymmetry::Axial && std::fabs(web.getOrientation()[8] - 1) < 1e-6f) return 0.0f;
    const bool half = symmetry == PhotoWebSymmetry::Half && endsAt(180);
    // A plane 360 beside plane 0 bends the light across it as no reader does that closes the circle itself.
    const bool full = symmetry == PhotoWebSymmetry::Full && web.getPsiRange().last < twoPi;
    if (!half && !full && !(symmetry == PhotoWebSymmetry::Quarter && endsAt(90))) return {};
    if (web.hasIdentityOrientation() || isTurned(web, turnedBy(0))) return 0.0f;
    if (half && isTurned(web, turnedBy(-90))) return -90.0f;
    if ((half || full) && rules.wraps && isTurned(web, turnedBy(-270))) return -270.0f;
    return {};
}

/// Planes of a web that is dark behind its last psi; those from -90 stand as 270.
std::optional<Nodes> truncatedPlanes(const Ov::RnPhotoWebData& web, const OwnGridRules& rules) {
    const int count = web.getPsiCount();
    const bool upright = web.hasIdentityOrientation() || isTurned(web, turnedBy(0));
    Nodes nodes;
    if (web.getSymmetry() == PhotoWebSymmetry::Half && upright) {
        nodes = psiNodes(web, 0);
        return addRimAbove(nodes, count, 180) ? std::optional(nodes) : std::nullopt;
    }
    const auto turn = uprightTurn(web);
    if (web.getSymmetry() != PhotoWebSymmetry::Full || !turn || !rules.wraps) return {};
    nodes = psiNodes(web, *turn);
    if (nodes.front().angle < -90 || nodes.back().angle > 180) return {};
    if (!addRimAbove(nodes, count, 270) || !addRimBelow(nodes, -1, -90)) return {};
    for (Node& node : nodes)
        if (node.angle < 0) node.angle += fullCircle;
    return nodes;
}

std::optional<Layout> polarLayoutOf(const Ov::RnPhotoWebData& web, const OwnGridRules& rules) {
    Layout layout{GridFrame::polar, thetaNodes(web, 0)};
    if (!reachEnds(layout.vertical, rules.tolerance)) return {};
    if (web.isPsiTruncated()) {
        auto planes = truncatedPlanes(web, rules);
        if (!planes) return {};
        layout.horizontal = std::move(*planes);
        return layout;
    }
    const auto shift = polarShift(web, rules);
    if (!shift) return {};
    layout.horizontal = psiNodes(web, *shift);
    if (web.getSymmetry() == PhotoWebSymmetry::Full)
        layout.horizontal.push_back({*shift < -180 ? layout.horizontal.front().angle : fullCircle, 0});
    return layout;
}

/// Whether a web that closes its circle is dark behind its last psi all the same.
bool isDarkBehind(const Ov::RnPhotoWebData& web) {
    if (web.getSymmetry() != PhotoWebSymmetry::Full) return false;
    const int last = web.getPsiCount() - 1;
    for (int i = 0; i < web.getThetaCount(); ++i)
        if (web.getCandela(0, i) != 0 || web.getCandela(last, i) != 0 || web.getCandela(1, i) < 0 ||
            web.getCandela(last - 1, i) < 0)
            return false;
    return true;
}

std::optional<Layout> lateralLayoutOf(const Ov::RnPhotoWebData& web, const OwnGridRules& rules) {
    // In a format whose files are not dark behind their last plane a truncated web ends in rims; in one whose files are
    // another web must be dark there already.
    const bool rims = web.isPsiTruncated() && !rules.lateralTruncated;
    if (web.isPsiTruncated() == rules.lateralTruncated ? web.getPsiCount() < 2 : !rims && !isDarkBehind(web))
        return {};

    // Angles to one side of 0 stay where they are.
    constexpr double rounding = 1e-4;  // of degrees from radians
    const double last = inDegrees(web.getPsiRange().last);
    Layout layout{GridFrame::upright, thetaNodes(web, 90)};
    if (web.getSymmetry() == PhotoWebSymmetry::Half && last <= 90 + rounding && web.hasIdentityOrientation() &&
        !rims) {
        layout.horizontal = psiNodes(web, 0);
        return layout;
    }
    if (web.getSymmetry() != PhotoWebSymmetry::Full) return {};

    // Angles to both sides were shifted by the turn of the web, which stands upright or lies.
    const auto fits = [&](std::optional<float> shift) {
        return shift && *shift > rules.tolerance && *shift <= 90 && last - *shift <= 90 + rounding;
    };
    auto turn = rules.uprightTurned ? uprightTurn(web) : std::nullopt;
    if (!fits(turn)) {
        turn = laidDownTurn(web);
        layout.frame = GridFrame::laidDown;
    }
    if (!fits(turn)) return {};

    // Shift them back, and end the light at rims where the format would go on.
    layout.horizontal = psiNodes(web, *turn);
    if (rims &&
        !(addRimAbove(layout.horizontal, web.getPsiCount(), 90) && addRimBelow(layout.horizontal, -1, -90)))
        return {};
    return layout;
}

CandelaGrid gridOf(const Layout& layout, const Ov::RnPhotoWebData& web, float peak) {
    CandelaGrid grid;
    grid.verticalCount = static_cast<std::int32_t>(layout.vertical.size());
    grid.horizontalCount = static_cast<std::int32_t>(layout.horizontal.size());
    grid.candelas.reserve(layout.vertical.size() * layout.horizontal.size());
    for (const Node& node : layout.vertical) grid.verticalAngles.push_back(static_cast<float>(node.angle));
    for (const Node& plane : layout.horizontal) {
        grid.horizontalAngles.push_back(static_cast<float>(plane.angle));
        for (const Node& node : layout.vertical) {
            const bool isLit = plane.index != dark && node.index != dark;
            grid.candelas.push_back(isLit ? web.getCandela(plane.index, node.index) * peak : 0);
        }
    }
    return grid;
}

}  // namespace

bool isTurned(const Ov::RnPhotoWebData& web, const GeLinearMatrix3<float>& turned, float tolerance) {
    const auto expected = turned.computeTranspose();
    const auto orientation = web.getOrientation();
    return std::equal(expected.values().begin(), expected.values().end(), orientation.values().begin(),
                      [=](float a, float b) { return std::fabs(a - b) < tolerance; });
}

bool ownGrid(const Ov::RnPhotoWebData& web, float peak, const OwnGridRules& rules, FileGrid& out) {
    if (web.getThetaCount() < 2 || web.getPsiCount() < 1) return false;
    if (inDegrees(std::fabs(web.getPsiRange().first)) > rules.tolerance) return false;
    const bool lateralFirst = web.isPsiTruncated() && rules.lateralTruncated;
    auto layout = lateralFirst ? lateralLayoutOf(web, rules) : polarLayoutOf(web, rules);
    if (!layout) layout = lateralFirst ? polarLayoutOf(web, rules) : lateralLayoutOf(web, rules);
    if (!layout) return false;
    out = {gridOf(*layout, web, peak), layout->frame};
    return true;
}

FileGrid faithfulGrid(Ov::RnIntensityDist& dist, const OwnGridRules& rules) {
    FileGrid file;
    const auto web = webOf(dist);
    if (web && ownGrid(*web, dist.getPeakIntensity(), rules, file)) return file;
    if (const auto planes = evenPlanes(dist))
        if (ownGrid(*planes, planes->getMaxCandela(), rules, file)) return file;
    return {sampledGrid(dist, planSampling(dist)), GridFrame::polar};
}

float scaleForFile(CandelaGrid& grid, double unit) {
    constexpr double leastPeak = 2000;  // so that half of the last decimal is less than 5e-6 of the peak
    double peak = 0;
    for (const float candela : grid.candelas) peak = std::max(peak, candela * unit);
    double power = 1;
    while (peak > 0 && peak * power < leastPeak) power *= 10;
    for (float& candela : grid.candelas)
        candela = static_cast<float>(std::round(candela * unit * power * 100) / 100);
    return static_cast<float>(1 / (unit * power));
}

}  // namespace OvPhotometrics
