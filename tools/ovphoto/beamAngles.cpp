#include "tools/ovphoto/beamAngles.h"

#include <cmath>
#include <numbers>

#include "tools/ovphoto/fileAngles.h"

namespace OvTool {

using namespace Ov;

namespace {

using OvPlot::AngleSpan;
using OvPlot::Vector;

constexpr int samplesPerDegree = 10;
constexpr int samples = 360 * samplesPerDegree;

/// The intensity in a plane as a function of the angle in degrees, of period 360: angle 0 lies at `axis`, 90
/// degrees at `side`.
class Curve {
public:
    Curve(const RnIntensityDist& light, const Vector& axis, const Vector& side)
        : _light(light), _axis(axis), _side(side) {}

    float operator()(double degrees) const {
        const double angle = degrees * std::numbers::pi / 180;
        const double c = std::cos(angle);
        const double s = std::sin(angle);
        return OvPlot::intensityTowards(
            _light, {c * _axis.x + s * _side.x, c * _axis.y + s * _side.y, c * _axis.z + s * _side.z});
    }

    /// The angle of the peak, that nearest to the axis where several are the same.
    double peak() const {
        double best = 0;
        for (int i = 1; i <= samples / 2; ++i) {
            for (const double angle : {double(i) / samplesPerDegree, -double(i) / samplesPerDegree}) {
                if ((*this)(angle) > (*this)(best)) best = angle;
            }
        }
        return best;
    }

    /// The first angle beyond `start`, in a direction of 1 or -1, where the intensity has fallen to `level`.
    std::optional<double> fallsTo(float level, double start, int direction) const {
        double above = start;
        for (int i = 1; i <= samples; ++i) {
            double below = start + double(direction * i) / samplesPerDegree;
            if ((*this)(below) > level) {
                above = below;
                continue;
            }
            for (int halving = 0; halving < 30; ++halving) {
                const double middle = (above + below) / 2;
                ((*this)(middle) > level ? above : below) = middle;
            }
            return below;
        }
        return {};
    }

    std::optional<AngleSpan> spanAt(float level, double start) const {
        const auto right = fallsTo(level, start, 1);
        const auto left = fallsTo(level, start, -1);
        if (!right || !left) return {};
        return AngleSpan{*left, *right};
    }

private:
    const RnIntensityDist& _light;
    Vector _axis;
    Vector _side;
};

BeamAngles anglesIn(const char* plane, const Curve& curve) {
    const double start = curve.peak();
    const float peak = curve(start);
    if (!(peak > 0)) return {plane, {}, {}};
    return {plane, curve.spanAt(peak * 0.5F, start), curve.spanAt(peak * 0.1F, start)};
}

}  // namespace

OvPlot::LuminaireFrame mainFrame(RnPhotoWebData& web) {
    const PhotoFileInfo file = fileInfoOf(web);
    const double psi = file.psi(0);
    const Vector towards0{std::cos(psi), std::sin(psi), 0};
    const Vector towards90{-towards0.y, towards0.x, 0};
    if (file.lateral) return {towards0, towards90, {0, 0, -1}, true};
    return {{0, 0, 1}, towards0, towards90, false};
}

std::vector<BeamAngles> beamAngles(const RnWebIntensityDist& light) {
    const OvPlot::LuminaireFrame frame = mainFrame(*light.getWeb());
    return {anglesIn(frame.aimed ? "horizontal" : "C0-C180", {light, frame.down, frame.c0}),
            anglesIn(frame.aimed ? "vertical" : "C90-C270", {light, frame.down, frame.c90})};
}

}  // namespace OvTool
