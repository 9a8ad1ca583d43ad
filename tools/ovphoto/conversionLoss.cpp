#include "tools/ovphoto/conversionLoss.h"

#include <algorithm>
#include <cmath>
#include <numbers>

#include "host/componentManager/castImpl.h"
#include "tools/ovphoto/numbers.h"

namespace OvTool {

using namespace Ov;

namespace {

/// Far enough from the rim of a dark range that rounding does not lead into it: 0.01 degree.
constexpr float inward = static_cast<float>(std::numbers::pi / 18000);

/// Differences of two lights towards angles in the frame of the first.
class Difference {
public:
    Difference(const RnIntensityDist& source, const RnIntensityDist& output)
        : _source(source), _output(output), _toHost(source.getOrientation().computeTranspose()) {
        const auto a = source.getOrientation().values();
        const auto b = output.getOrientation().values();
        _sameFrame =
            std::equal(a.begin(), a.end(), b.begin(), [](float x, float y) { return std::abs(x - y) < 1e-5F; });
    }

    double operator()(float theta, float psi) const {
        if (_sameFrame) return apart(_source.localIntensity(theta, psi), _output.localIntensity(theta, psi));
        const double across = std::sin(double(theta));
        const GeVector3<float> local{static_cast<float>(across * std::cos(double(psi))),
                                     static_cast<float>(across * std::sin(double(psi))),
                                     static_cast<float>(std::cos(double(theta)))};
        const GeVector3<float> host = _toHost * local;
        return apart(_source.intensityAt(host), _output.intensityAt(host));
    }

private:
    static double apart(float a, float b) { return std::abs(double(a) - b); }

    const RnIntensityDist& _source;
    const RnIntensityDist& _output;
    GeLinearMatrix3<float> _toHost;
    bool _sameFrame;
};

/// A range of angles and which of its ends are rims of darkness.
struct LitRange {
    AngleRange angles;
    bool firstIsRim;
    bool lastIsRim;

    /// The angle, moved off the rim where it lies there.
    float movedIn(float angle) const {
        if (firstIsRim && angle <= angles.first) return angles.first + inward;
        return lastIsRim && angle >= angles.last ? angles.last - inward : angle;
    }
};

LitRange thetasOf(const RnPhotoWebData& web) {
    const AngleRange angles = web.getThetaRange();
    return {angles, angles.first > 0, angles.last < static_cast<float>(std::numbers::pi)};
}

LitRange psisOf(const RnPhotoWebData& web) {
    const bool dark = web.isPsiTruncated();
    return {web.getPsiRange(), dark && web.getSymmetry() == PhotoWebSymmetry::Full, dark};
}

double overGrid(const RnPhotoWebData& web, const Difference& difference) {
    const LitRange thetas = thetasOf(web);
    const LitRange psis = psisOf(web);
    double largest = 0;
    for (int j = 0; j < web.getPsiCount(); ++j) {
        const float psi = web.getPsi(j);
        const float innerPsi = psis.movedIn(psi);
        for (int i = 0; i < web.getThetaCount(); ++i) {
            const float theta = web.getTheta(i);
            const float innerTheta = thetas.movedIn(theta);
            double here = difference(theta, psi);
            const bool onRim = innerTheta != theta || innerPsi != psi;
            if (onRim && here > largest) here = std::min(here, difference(innerTheta, innerPsi));
            largest = std::max(largest, here);
        }
    }
    return largest;
}

/// For lights that are the same all around their axis.
double fromAxis(const Difference& difference) {
    double largest = 0;
    for (int step = 0; step <= 360; ++step)
        largest = std::max(largest, difference(toRadians(static_cast<float>(step) / 2), 0));
    return largest;
}

/// `part` in per cent of `whole`; where that is 0, all or nothing.
double percent(double part, double whole) { return whole > 0 ? part / whole * 100 : part == 0 ? 0 : 100; }

}  // namespace

ConversionLoss measureLoss(RnIntensityDist& source, const RnIntensityDist& output) {
    const auto withWeb = rnQuery<RnWebIntensityDist>(&source);
    const Difference difference(source, output);
    ConversionLoss loss;
    loss.candela = withWeb ? overGrid(*withWeb->getWeb(), difference) : fromAxis(difference);
    loss.candelaPercent = percent(loss.candela, source.getPeakIntensity());
    loss.fluxPercent = percent(double(output.getFlux()) - source.getFlux(), source.getFlux());
    return loss;
}

}  // namespace OvTool
