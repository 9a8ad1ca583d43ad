#include "tools/ovphoto/conversionLoss.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <vector>

#include "components/support/castImpl.h"
#include "tools/numbers/numbers.h"

namespace OvTool {

using namespace Ov;

namespace {

constexpr float degree = static_cast<float>(std::numbers::pi / 180);
constexpr double circle = 2 * std::numbers::pi;

/// So far from the rim of a dark range that rounding does not lead into the dark.
constexpr float atRim = 0.01F * degree;

/// The web that a distribution holds, or null.
const RnPhotoWebData* webOf(RnIntensityDist& light) {
    const auto withWeb = rnQuery<RnWebIntensityDist>(&light);
    return withWeb ? withWeb->getWeb() : nullptr;
}

/// Behind the steps, of a degree or so, that light takes to fall off at a rim on an even grid, in both directions.
float behindRim(const RnPhotoWebData* web) {
    if (!web) return atRim;
    float step = 0;
    if (web->getThetaCount() > 1) step = web->getTheta(1) - web->getTheta(0);
    if (web->getPsiCount() > 1) step = std::max(step, web->getPsi(1) - web->getPsi(0));
    return std::clamp(3 * step, atRim, 3 * degree);
}

struct Angles {
    float theta, psi;

    explicit Angles(float ofTheta, float ofPsi) : theta(ofTheta), psi(ofPsi) {}
    explicit Angles(const GeVector3<float>& direction)
        : theta(std::atan2(std::hypot(direction.x, direction.y), direction.z)),
          psi(std::atan2(direction.y, direction.x)) {
        if (psi < 0) psi += static_cast<float>(circle);
    }
    GeVector3<float> direction() const {
        const double across = std::sin(double(theta));
        return {static_cast<float>(across * std::cos(double(psi))),
                static_cast<float>(across * std::sin(double(psi))), static_cast<float>(std::cos(double(theta)))};
    }
};

/// Two lights towards angles in the frame of the first.
class Pair {
public:
    Pair(const RnIntensityDist& source, const RnIntensityDist& output)
        : _source(source), _output(output), _toHost(source.getOrientation().computeTranspose()) {
        const auto a = source.getOrientation().values();
        const auto b = output.getOrientation().values();
        _sameFrame =
            std::equal(a.begin(), a.end(), b.begin(), [](float x, float y) { return std::abs(x - y) < 1e-5F; });
    }

    struct Candela {
        double source, output;
        double apart() const { return std::abs(source - output); }
    };
    Candela at(float theta, float psi) const {
        if (_sameFrame) return {_source.localIntensity(theta, psi), _output.localIntensity(theta, psi)};
        const GeVector3<float> host = _toHost * Angles(theta, psi).direction();
        return {_source.intensityAt(host), _output.intensityAt(host)};
    }
    double source(float theta, float psi) const { return _source.localIntensity(theta, psi); }
    bool sameFrame() const { return _sameFrame; }
    /// In the frame of the source.
    Angles ofOutput(float theta, float psi) const {
        if (_sameFrame) return Angles(theta, psi);
        const auto toHost = _output.getOrientation().computeTranspose();
        return Angles(_source.getOrientation() * (toHost * Angles(theta, psi).direction()));
    }
    /// Whether both are the same all around one axis.
    bool axial() const {
        return _sameFrame && _source.getSymmetry() == PhotoWebSymmetry::Axial &&
               _output.getSymmetry() == PhotoWebSymmetry::Axial;
    }

private:
    const RnIntensityDist& _source;
    const RnIntensityDist& _output;
    GeLinearMatrix3<float> _toHost;
    bool _sameFrame;
};

/// A range of angles and which of its ends are rims: of darkness, or poles that have another value in each plane.
struct LitRange {
    AngleRange angles;
    bool firstIsRim;
    bool lastIsRim;

    /// The angle, moved in behind a rim that is nearer than `rim`.
    float movedIn(float angle, float rim) const {
        const auto isAt = [&](float end) { return std::abs(std::remainder(double(angle) - end, circle)) < rim; };
        const float middle = (angles.first + angles.last) / 2;
        if (firstIsRim && isAt(angles.first)) return std::min(angles.first + rim, middle);
        if (lastIsRim && isAt(angles.last)) return std::max(angles.last - rim, middle);
        return angle;
    }
};

bool isPole(float theta) { return std::abs(std::sin(double(theta))) < 1e-6; }

bool isRim(const RnPhotoWebData& web, int thetaIndex) {
    if (!isPole(web.getTheta(thetaIndex))) return true;
    const auto differs = [&](int j) {
        return std::abs(web.getCandela(j, thetaIndex) - web.getCandela(0, thetaIndex)) > keptPercent / 100;
    };
    for (int j = 1; j < web.getPsiCount(); ++j)
        if (differs(j)) return true;
    return web.isPsiTruncated() && web.getCandela(0, thetaIndex) > keptPercent / 100;
}

LitRange thetasOf(const RnPhotoWebData& web) {
    return {web.getThetaRange(), isRim(web, 0), isRim(web, web.getThetaCount() - 1)};
}

LitRange psisOf(const RnPhotoWebData& web) {
    const bool dark = web.isPsiTruncated();
    return {web.getPsiRange(), dark && web.getSymmetry() == PhotoWebSymmetry::Full, dark};
}

/// Where the horizontal range of a web ends that goes on behind its last plane; else its last plane.
float endOfPsis(const RnPhotoWebData& web) {
    const float last = web.getPsiRange().last;
    const auto end = [&](double turns) { return std::max(last, static_cast<float>(turns * circle)); };
    if (web.isPsiTruncated()) return last;
    switch (web.getSymmetry()) {
        case PhotoWebSymmetry::Full:
            return end(1);
        case PhotoWebSymmetry::Half:
            return end(0.5);
        case PhotoWebSymmetry::Quarter:
            return end(0.25);
        case PhotoWebSymmetry::Axial:
            break;
    }
    return last;
}

/// The angles, and the steps between them in equal parts.
std::vector<float> inParts(const std::vector<float>& angles, int parts) {
    std::vector<float> all;
    for (const float angle : angles) {
        const float step = all.empty() ? 0 : angle - all.back();
        for (int part = parts - 1; part > 0 && step > 0; --part)
            all.push_back(angle - step * static_cast<float>(part) / static_cast<float>(parts));
        all.push_back(angle);
    }
    return all;
}

std::vector<float> thetaList(const RnPhotoWebData& web) {
    std::vector<float> thetas;
    for (int i = 0; i < web.getThetaCount(); ++i) thetas.push_back(web.getTheta(i));
    return thetas;
}

std::vector<float> psiList(const RnPhotoWebData& web) {
    std::vector<float> psis;
    for (int j = 0; j < web.getPsiCount(); ++j) psis.push_back(web.getPsi(j));
    if (const float end = endOfPsis(web); end > psis.back()) psis.push_back(end);
    // What a plane 360 is like only shows before it: at 360 it is plane 0 that stands.
    if (web.getPsiRange().last > static_cast<float>(circle) - atRim) psis.back() -= atRim;
    return psis;
}

/// At a pole a web may hold another value in each plane, and darkness between them: what another light gives there
/// is as good as any value in that range.
double apartAtPole(const RnPhotoWebData& web, const Pair& lights, int thetaIndex) {
    const float theta = web.getTheta(thetaIndex);
    std::vector<double> candela;
    for (int j = 0; j < web.getPsiCount(); ++j) candela.push_back(lights.source(theta, web.getPsi(j)));
    if (web.isPsiTruncated()) candela.push_back(0);
    const auto [least, most] = std::minmax_element(candela.begin(), candela.end());
    const double output = lights.at(theta, 0).output;
    return std::max({0.0, *least - output, output - *most});
}

/// The largest difference of two lights, `rim` behind the rims of the source where they are as near.
class Largest {
public:
    Largest(const RnPhotoWebData& source, const Pair& lights, float rim)
        : _lights(lights), _thetas(thetasOf(source)), _psis(psisOf(source)), _rim(rim) {
        for (const int end : {0, source.getThetaCount() - 1})
            if (isPole(source.getTheta(end))) _candela = std::max(_candela, apartAtPole(source, lights, end));
    }

    double candela() const { return _candela; }

    void lookAt(const Angles& angles) {
        const auto& [theta, psi] = angles;
        if (isPole(theta)) return;
        double here = _lights.at(theta, psi).apart();
        if (here <= _candela) return;
        const float across = _lights.sameFrame() ? 1 : std::sin(theta);
        const Angles inner(_thetas.movedIn(theta, _rim), _psis.movedIn(psi, _rim / across));
        const bool onRim = inner.theta != theta || inner.psi != psi;
        if (onRim) here = std::min(here, _lights.at(inner.theta, inner.psi).apart());
        _candela = std::max(_candela, here);
    }

private:
    const Pair& _lights;
    LitRange _thetas;
    LitRange _psis;
    float _rim;
    double _candela = 0;
};

/// Over the grid of the source and all midway, then along the lines of the other's finer grid, where that gives it.
double overGrids(const RnPhotoWebData& source, const RnPhotoWebData* output, const Pair& lights, float rim) {
    Largest largest(source, lights, rim);
    const std::vector<float> thetas = thetaList(source);
    const std::vector<float> psis = psiList(source);
    for (const float psi : inParts(psis, 2))
        for (const float theta : inParts(thetas, 2)) largest.lookAt(Angles(theta, psi));
    if (!output) return largest.candela();
    const std::vector<float> outputThetas = thetaList(*output);
    const std::vector<float> outputPsis = psiList(*output);
    if (lights.sameFrame() && outputThetas == thetas && outputPsis == psis) return largest.candela();
    for (const float psi : inParts(outputPsis, 4))
        for (const float theta : outputThetas) largest.lookAt(lights.ofOutput(theta, psi));
    for (const float psi : outputPsis)
        for (const float theta : inParts(outputThetas, 4)) largest.lookAt(lights.ofOutput(theta, psi));
    return largest.candela();
}

/// For lights that are the same all around their axis.
double fromAxis(const Pair& lights) {
    double largest = 0;
    for (int step = 0; step <= 360; ++step)
        largest = std::max(largest, lights.at(toRadians(static_cast<float>(step) / 2), 0).apart());
    return largest;
}

/// What both give off, up to a factor that is the same: sums over the middles of cells that no rim of the source
/// cuts in theta.
Pair::Candela gaveOff(const Pair& lights, std::vector<float> edges, int leastParts) {
    constexpr double widest = std::numbers::pi / 180;
    edges.push_back(0);
    edges.push_back(static_cast<float>(std::numbers::pi));
    std::sort(edges.begin(), edges.end());
    const int planes = lights.axial() ? 1 : 180;
    Pair::Candela sum{0, 0};
    for (std::size_t k = 1; k < edges.size(); ++k) {
        const double width = double(edges[k]) - edges[k - 1];
        const int parts = std::max(leastParts, static_cast<int>(std::ceil(width / widest)));
        for (int part = 0; part < parts && width > 0; ++part) {
            const double theta = edges[k - 1] + width * (part + 0.5) / parts;
            const double weight = std::sin(theta) * width / parts / planes;
            for (int plane = 0; plane < planes; ++plane) {
                const double psi =
                    2 * std::numbers::pi * (plane + 0.37) / planes;  // off the rims of whole degrees
                const auto here = lights.at(static_cast<float>(theta), static_cast<float>(psi));
                sum.source += weight * here.source;
                sum.output += weight * here.output;
            }
        }
    }
    return sum;
}

/// `part` in per cent of `whole`; where that is 0, all or nothing.
double percent(double part, double whole) { return whole > 0 ? part / whole * 100 : part == 0 ? 0 : 100; }

}  // namespace

ConversionLoss measureLoss(RnIntensityDist& source, RnIntensityDist& output) {
    const RnPhotoWebData* const web = webOf(source);
    const RnPhotoWebData* const made = webOf(output);
    const Pair lights(source, output);
    const AngleRange thetas = source.getThetaRange();
    const Pair::Candela sums =
        gaveOff(lights, web ? thetaList(*web) : std::vector{thetas.first, thetas.last}, web ? 2 : 64);
    ConversionLoss loss;
    loss.candela = web ? overGrids(*web, made, lights, atRim) : fromAxis(lights);
    loss.candelaPercent = percent(loss.candela, source.getPeakIntensity());
    if (web && loss.candelaPercent > keptPercent) {
        const double inside = overGrids(*web, made, lights, behindRim(made));
        if (inside < loss.candela) loss.rimCandela = loss.candela;
        loss.candela = inside;
        loss.candelaPercent = percent(inside, source.getPeakIntensity());
    }
    loss.fluxPercent = percent(sums.output - sums.source, sums.source);
    return loss;
}

}  // namespace OvTool
