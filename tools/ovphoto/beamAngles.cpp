#include "tools/ovphoto/beamAngles.h"

#include <cmath>
#include <numbers>

namespace OvTool {

using namespace Ov;

namespace {

using Vector = GeVector3<double>;

/// A great circle of directions in the web's frame: angle 0 lies at `axis`, 90 degrees at `side`.
struct Plane {
    const char* name;
    Vector axis;
    Vector side;
};

constexpr int samplesPerDegree = 10;
constexpr int samples = 360 * samplesPerDegree;

/// The intensity in a plane as a function of the angle in degrees, of period 360.
class Curve {
public:
    Curve(const RnIntensityDist& light, const Plane& plane) : _light(light), _plane(plane) {}

    float operator()(double degrees) const {
        const double angle = degrees * std::numbers::pi / 180;
        const double c = std::cos(angle);
        const double s = std::sin(angle);
        const double x = c * _plane.axis.x + s * _plane.side.x;
        const double y = c * _plane.axis.y + s * _plane.side.y;
        const double z = c * _plane.axis.z + s * _plane.side.z;
        return _light.localIntensity(static_cast<float>(std::atan2(std::hypot(x, y), z)),
                                     static_cast<float>(std::atan2(y, x)));
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

    std::optional<double> widthAt(float level, double start) const {
        const auto right = fallsTo(level, start, 1);
        const auto left = fallsTo(level, start, -1);
        if (!right || !left) return {};
        return *right - *left;
    }

private:
    const RnIntensityDist& _light;
    const Plane& _plane;
};

Vector turned(const GeLinearMatrix3<float>& matrix, double x, double y, double z) {
    return {matrix[0] * x + matrix[3] * y + matrix[6] * z, matrix[1] * x + matrix[4] * y + matrix[7] * z,
            matrix[2] * x + matrix[5] * y + matrix[8] * z};
}

/// The photometric axis of a type A or B web in its own frame: what lies at the host's +X, or, where the poles are
/// turned into the horizontal (type B), at its -Y.
Vector photometricAxis(const RnPhotoWebData& web) {
    if (web.hasIdentityOrientation()) return {1, 0, 0};
    const GeLinearMatrix3<float> matrix = web.getOrientation();
    const Vector axis = std::abs(matrix[8]) > 0.5 ? turned(matrix, 1, 0, 0) : turned(matrix, 0, -1, 0);
    return {axis.x, axis.y, 0};
}

std::vector<Plane> mainPlanes(const RnPhotoWebData& web) {
    if (web.isPsiTruncated()) {
        const Vector axis = photometricAxis(web);
        return {{"horizontal", axis, {-axis.y, axis.x, 0}}, {"vertical", axis, {0, 0, -1}}};
    }
    const GeLinearMatrix3<float> matrix =
        web.hasIdentityOrientation() ? GeLinearMatrix3<float>() : web.getOrientation();
    const Vector axis = turned(matrix, 0, 0, 1);
    return {{"C0-C180", axis, turned(matrix, 1, 0, 0)}, {"C90-C270", axis, turned(matrix, 0, 1, 0)}};
}

}  // namespace

std::vector<BeamAngles> beamAngles(const RnWebIntensityDist& light) {
    std::vector<BeamAngles> result;
    for (const Plane& plane : mainPlanes(*light.getWeb())) {
        const Curve curve(light, plane);
        const double start = curve.peak();
        const float peak = curve(start);
        BeamAngles& angles = result.emplace_back(BeamAngles{plane.name, {}, {}});
        if (!(peak > 0)) continue;
        angles.beam = curve.widthAt(peak * 0.5F, start);
        angles.field = curve.widthAt(peak * 0.1F, start);
    }
    return result;
}

}  // namespace OvTool
