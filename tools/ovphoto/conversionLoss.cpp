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

constexpr double keptPercent = 0.1;  // of the peak, by every conversion that can
constexpr float degree = static_cast<float>(std::numbers::pi / 180);

/// So far from the rim of a dark range that rounding does not lead into the dark.
constexpr float atRim = 0.01F * degree;

/// Behind the steps, of a degree or so, that light takes to fall off at a rim on an even grid, in both directions.
float behindRim(RnIntensityDist& output) {
    const auto withWeb = rnQuery<RnWebIntensityDist>(&output);
    const RnPhotoWebData* const web = withWeb ? withWeb->getWeb() : nullptr;
    if (!web) return atRim;
    float step = 0;
    if (web->getThetaCount() > 1) step = web->getTheta(1) - web->getTheta(0);
    if (web->getPsiCount() > 1) step = std::max(step, web->getPsi(1) - web->getPsi(0));
    return std::clamp(3 * step, atRim, 3 * degree);
}

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
        const double across = std::sin(double(theta));
        const GeVector3<float> local{static_cast<float>(across * std::cos(double(psi))),
                                     static_cast<float>(across * std::sin(double(psi))),
                                     static_cast<float>(std::cos(double(theta)))};
        const GeVector3<float> host = _toHost * local;
        return {_source.intensityAt(host), _output.intensityAt(host)};
    }
    double source(float theta, float psi) const { return _source.localIntensity(theta, psi); }
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

/// A range of angles and which of its ends are rims of darkness.
struct LitRange {
    AngleRange angles;
    bool firstIsRim;
    bool lastIsRim;
    float rim;  // how wide

    /// The angle, moved off the rim where it lies there.
    float movedIn(float angle) const {
        const float middle = (angles.first + angles.last) / 2;
        const float first = std::min(angles.first + rim, middle);
        const float last = std::max(angles.last - rim, middle);
        if (firstIsRim && angle < first) return first;
        return lastIsRim && angle > last ? last : angle;
    }
};

LitRange thetasOf(const RnPhotoWebData& web, float rim) {
    const AngleRange angles = web.getThetaRange();
    return {angles, angles.first > 0, angles.last < static_cast<float>(std::numbers::pi), rim};
}

LitRange psisOf(const RnPhotoWebData& web, float rim) {
    const bool dark = web.isPsiTruncated();
    return {web.getPsiRange(), dark && web.getSymmetry() == PhotoWebSymmetry::Full, dark, rim};
}

/// Where the horizontal range of a web ends that goes on behind its last plane; else its last plane.
float endOfPsis(const RnPhotoWebData& web) {
    const float last = web.getPsiRange().last;
    const auto end = [&](double turns) {
        return std::max(last, static_cast<float>(turns * 2 * std::numbers::pi));
    };
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

/// The angles and what lies midway between them.
std::vector<float> withMidpoints(const std::vector<float>& angles) {
    std::vector<float> all;
    for (const float angle : angles) {
        if (!all.empty() && angle > all.back()) all.push_back((all.back() + angle) / 2);
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
    return psis;
}

bool isPole(float theta) { return std::abs(std::sin(double(theta))) < 1e-6; }

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

double overGrid(const RnPhotoWebData& web, const Pair& lights, float rim) {
    const LitRange thetas = thetasOf(web, rim);
    const LitRange psis = psisOf(web, rim);
    const std::vector<float> allThetas = withMidpoints(thetaList(web));
    double largest = 0;
    for (const float psi : withMidpoints(psiList(web))) {
        const float innerPsi = psis.movedIn(psi);
        for (const float theta : allThetas) {
            if (isPole(theta)) continue;
            const float innerTheta = thetas.movedIn(theta);
            double here = lights.at(theta, psi).apart();
            const bool onRim = innerTheta != theta || innerPsi != psi;
            if (onRim && here > largest) here = std::min(here, lights.at(innerTheta, innerPsi).apart());
            largest = std::max(largest, here);
        }
    }
    for (const int end : {0, web.getThetaCount() - 1})
        if (isPole(web.getTheta(end))) largest = std::max(largest, apartAtPole(web, lights, end));
    return largest;
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
    const auto withWeb = rnQuery<RnWebIntensityDist>(&source);
    const RnPhotoWebData* const web = withWeb ? withWeb->getWeb() : nullptr;
    const Pair lights(source, output);
    const AngleRange thetas = source.getThetaRange();
    const Pair::Candela sums =
        gaveOff(lights, web ? thetaList(*web) : std::vector{thetas.first, thetas.last}, web ? 2 : 64);
    ConversionLoss loss;
    loss.candela = web ? overGrid(*web, lights, atRim) : fromAxis(lights);
    loss.candelaPercent = percent(loss.candela, source.getPeakIntensity());
    if (web && loss.candelaPercent > keptPercent) {
        const double inside = overGrid(*web, lights, behindRim(output));
        if (inside < loss.candela) loss.rimCandela = loss.candela;
        loss.candela = inside;
        loss.candelaPercent = percent(inside, source.getPeakIntensity());
    }
    loss.fluxPercent = percent(sums.output - sums.source, sums.source);
    return loss;
}

}  // namespace OvTool
