#include "components/photo/files/gridLayout.h"

#include <algorithm>
#include <cmath>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/reportMessage.h"

namespace OvPhotometrics {

namespace {

/// Whether angles of a file are the same within its format's tolerance, in single precision.
struct SameWithin {
    float tolerance;
    bool operator()(float a, float b) const { return a + tolerance >= b && a <= b + tolerance; }
};

template <class... Types>
bool refuse(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) {
    reportMessage(message, arguments...);
    return false;
}

bool ascend(const std::vector<float>& angles) { return std::is_sorted(angles.begin(), angles.end()); }

bool checkAngleOrder(const CandelaGrid& grid, bool anyHorizontalOrder) {
    if (!ascend(grid.verticalAngles)) return refuse(messages::verticalAnglesDecrease);
    return anyHorizontalOrder || ascend(grid.horizontalAngles) || refuse(messages::horizontalAnglesDecrease);
}

/// Planes that start at 0.
bool layoutFrom0(const CandelaGrid& grid, const PolarRules& rules, WebLayout& layout) {
    const SameWithin same{rules.tolerance};
    const float hn = grid.horizontalAngles.back();
    const int n = grid.horizontalCount;
    if (n == 1 || (n == 2 && same(hn, 360))) {
        layout.symmetry = PhotoWebSymmetry::Axial;
        layout.columns = 1;
    } else if (same(hn, 90)) {
        layout.symmetry = PhotoWebSymmetry::Quarter;
    } else if (same(hn, 180)) {
        layout.symmetry = PhotoWebSymmetry::Half;
    } else if (hn > 180 + rules.tolerance && hn <= 360 + rules.tolerance) {
        layout.symmetry = PhotoWebSymmetry::Full;
        if (same(hn, 360)) layout.columns = n - 1;  // plane 360 repeats plane 0
    } else {
        return refuse(rules.lastHorizontal, hn);
    }
    return true;
}

}  // namespace

bool polarLayout(const CandelaGrid& grid, const PolarRules& rules, WebLayout& layout) {
    const SameWithin same{rules.tolerance};
    const float h0 = grid.horizontalAngles.front();
    const float hn = grid.horizontalAngles.back();
    const bool from270 = rules.from270 && same(h0, 270);
    if (!checkAngleOrder(grid, from270)) return false;

    const float v0 = grid.verticalAngles.front();
    const float vn = grid.verticalAngles.back();
    const bool lower = same(v0, 0) && (same(vn, 90) || same(vn, 180));
    if (!lower && !(same(v0, 90) && same(vn, 180))) return refuse(rules.verticalRange);

    layout = {.columns = grid.horizontalCount};
    if (same(h0, 0)) return layoutFrom0(grid, rules, layout);
    const bool from90 = same(h0, 90) && same(hn, 270);
    if (!from90 && !from270) return refuse(rules.firstHorizontal, h0);
    layout.horizontalShift = from90 ? -90 : -270;
    if (from90 || same(hn, 90)) {
        layout.symmetry = PhotoWebSymmetry::Half;
    } else if (same(hn, 270)) {
        --layout.columns;  // the last plane repeats the first
    }
    return true;
}

bool lateralLayout(const CandelaGrid& grid, const LateralRules& rules, WebLayout& layout) {
    if (!checkAngleOrder(grid, false)) return false;
    const SameWithin same{rules.tolerance};
    const float t = rules.tolerance;
    const float v0 = grid.verticalAngles.front();
    const float vn = grid.verticalAngles.back();
    const float shift = vn > 90 + t ? 0.0f : 90.0f;
    if (v0 + t < -shift || vn > 180 - shift + t) return refuse(rules.verticalRange);
    if (grid.horizontalCount < 2) return refuse(rules.horizontalCount);

    const float h0 = grid.horizontalAngles.front();
    const bool oneSided = same(h0, 0);
    if (grid.horizontalAngles.back() > 90 + t || (!oneSided && (h0 + t >= 0 || h0 + t < -90)))
        return refuse(rules.horizontalRange);
    layout = {.symmetry = oneSided ? PhotoWebSymmetry::Half : PhotoWebSymmetry::Full,
              .columns = grid.horizontalCount,
              .verticalShift = shift,
              .horizontalShift = oneSided ? 0 : -h0,
              .lateral = true};
    return true;
}

void fillWebRecord(PhotoWebRecord& rec, const CandelaGrid& grid, const WebLayout& layout, float factor) {
    // An angle that is not shifted stays as it is, a negative zero included.
    const auto shifted = [](const std::vector<float>& angles, int k, double shift) {
        const double angle = angles[static_cast<std::size_t>(k)];
        return shift != 0 ? angle + shift : angle;
    };
    for (int i = 0; i < grid.verticalCount; ++i)
        photoWebRecordSetTheta(rec, i, toRadians(shifted(grid.verticalAngles, i, layout.verticalShift)));
    for (int j = 0; j < layout.columns; ++j) {
        const double psi = shifted(grid.horizontalAngles, j, layout.horizontalShift);
        photoWebRecordSetPsi(rec, j, toRadians(psi < -0.5 ? psi + 360 : psi));  // planes from 270 run on through 0
        photoWebRecordSetRow(rec, j, &grid.candelas[grid.index(0, j)], factor);
    }
    rec.file.verticalShift = layout.verticalShift;
    rec.file.horizontalShift = layout.horizontalShift;
    rec.file.lateral = layout.lateral;
    if (layout.columns < grid.horizontalCount) rec.file.closingPlane = grid.horizontalAngles.back();
}

GeLinearMatrix3<float> turnedBy(float degrees) {
    const double a = inRadians(degrees);
    const auto c = static_cast<float>(std::cos(a));
    const auto s = static_cast<float>(std::sin(a));
    return GeLinearMatrix3<float>({c, -s, 0, s, c, 0, 0, 0, 1});
}

GeLinearMatrix3<float> laidDownBy(float degrees, double second) {
    const double b = inRadians(degrees + 90.0);
    const double values[] = {std::cos(second) * std::cos(b),
                             -std::sin(b),
                             std::sin(second) * std::cos(b),
                             std::cos(second) * std::sin(b),
                             std::cos(b),
                             std::sin(second) * std::sin(b),
                             -std::sin(second),
                             0,
                             std::cos(second)};
    std::array<float, 9> rounded;
    std::transform(std::begin(values), std::end(values), rounded.begin(),
                   [](double value) { return static_cast<float>(value); });
    return GeLinearMatrix3<float>(rounded);
}

}  // namespace OvPhotometrics
