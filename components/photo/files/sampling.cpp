#include "components/photo/files/sampling.h"

#include <algorithm>
#include <cmath>
#include <numeric>

#include "components/photo/files/webDistribution.h"
#include "components/support/castImpl.h"

namespace OvPhotometrics {

namespace {

constexpr double finest = 1;            // degrees
constexpr double finestDetail = 0.05;   // degrees, of light that coarser steps lose and these keep
constexpr int mostDetailed = 1 << 16;   // values of a grid of such steps
constexpr double stepOfFormulas = 5;    // where no web says how fine a distribution is
constexpr double allowedLoss = 0.0007;  // of the peak, midway on the edges of a cell; inside it is a little more
constexpr double sameAngle = 0.005;     // degrees

/// What is left of a symmetry after a turn about the axis.
PhotoWebSymmetry turned(PhotoWebSymmetry symmetry, double degrees) {
    const auto multipleOf = [&](double angle) { return std::fabs(std::remainder(degrees, angle)) < sameAngle; };
    const bool kept = symmetry == PhotoWebSymmetry::Axial ||
                      (symmetry == PhotoWebSymmetry::Quarter && multipleOf(90)) ||
                      (symmetry == PhotoWebSymmetry::Half && multipleOf(180));
    return kept ? symmetry : PhotoWebSymmetry::Full;
}

/// The largest step from `least` up to `limit` degrees that divides 90 and is a multiple of 0.01, or of 1.
double stepUpTo(double limit, bool wholeDegrees, double least = finest) {
    for (int parts = 1; parts * least < 90; ++parts)
        if ((wholeDegrees ? 90 : 9000) % parts == 0 && 90.0 / parts <= limit + sameAngle) return 90.0 / parts;
    return least;
}

double smallestStep(int count, auto angleAt) {
    double smallest = 90;
    for (int k = 1; k < count; ++k) {
        const double step = inDegrees(static_cast<double>(angleAt(k)) - angleAt(k - 1));
        if (step > sameAngle) smallest = std::min(smallest, step);
    }
    return smallest;
}

/// The web that a file of a plan's grid gives.
class PlannedWeb final : public Ov::RnCastHeap<Ov::RnCastImpl<RnBasePhotoWebData, Ov::RnPhotoWebData>> {
public:
    PlannedWeb(const HostView& view, const SamplingPlan& plan, bool planeKept) {
        const int nthetas = plan.thetaCount();
        const int npsis = plan.psiCount() - (plan.symmetry == PhotoWebSymmetry::Full && !planeKept ? 1 : 0);
        PhotoWebRecord rec;
        photoWebRecordInit(rec, nthetas, npsis, plan.symmetry, false, true, L"");
        for (int i = 0; i < nthetas; ++i) photoWebRecordSetTheta(rec, i, toRadians(plan.theta(i)));
        for (int j = 0; j < npsis; ++j) {
            photoWebRecordSetPsi(rec, j, toRadians(plan.psi(j)));
            for (int i = 0; i < nthetas; ++i)
                photoWebRecordSetCandela(rec, i, j, view.intensity(plan.theta(i), plan.psi(j)));
        }
        photoWebInstall(*this, rec);
    }

    RnRef<Ov::RnPhotoWebData> clone() const override { return {}; }
    /// Candela by angles in degrees.
    float intensity(double theta, double psi) const {
        return _content.maxCandela * getIntensity(toRadians(theta), toRadians(psi));
    }
};

/// Whether a plan keeps what lies between its angles, in one direction or the other.
class LossCheck {
public:
    LossCheck(const HostView& view, const SamplingPlan& plan, bool planeKept)
        : _view(view), _plan(plan), _web(Ov::rnCreate<PlannedWeb>(view, plan, planeKept)) {}

    bool thetasFine() const {
        for (int j = 0; j < _plan.psiCount(); ++j)
            for (int i = 0; i + 1 < _plan.thetaCount(); ++i)
                for (const double part : parts)
                    if (loses(std::lerp(_plan.theta(i), _plan.theta(i + 1), part), _plan.psi(j))) return false;
        return true;
    }
    bool psisFine() const {
        for (int j = 0; j + 1 < _plan.psiCount(); ++j)
            for (int i = 0; i < _plan.thetaCount(); ++i)
                for (const double part : parts)
                    if (loses(_plan.theta(i), _plan.psi(j) + _plan.psiStep * part)) return false;
        return true;
    }

private:
    static constexpr double parts[] = {0.25, 0.5, 0.75};  // of a step

    bool loses(double theta, double psi) const {
        const double loss =
            std::fabs(static_cast<double>(_view.intensity(theta, psi)) - _web->intensity(theta, psi));
        return loss > allowedLoss * _web->getMaxCandela();
    }

    const HostView& _view;
    const SamplingPlan& _plan;
    RnRef<PlannedWeb> _web;
};

/// A plan with steps below 1 degree in one direction, if some keep all of the light on a grid that is not too large.
SamplingPlan detailed(const SamplingPlan& plan, double SamplingPlan::*step, bool (LossCheck::*isFine)() const,
                      const HostView& view, const SamplingRules& rules) {
    SamplingPlan finer = plan;
    while (!(LossCheck(view, finer, rules.planeKept).*isFine)()) {
        if (finer.*step <= finestDetail) return plan;
        finer.*step = stepUpTo(finer.*step / 2, false, finestDetail);
        if (std::int64_t{finer.thetaCount()} * finer.psiCount() > mostDetailed) return plan;
    }
    return finer;
}

SamplingPlan refined(SamplingPlan plan, const HostView& view, const SamplingRules& rules) {
    for (;;) {
        const LossCheck check(view, plan, rules.planeKept);
        const bool refineThetas = plan.thetas.empty() && plan.thetaStep > finest && !check.thetasFine();
        const bool refinePsis = plan.psiStep > finest && !check.psisFine();
        if (!refineThetas && !refinePsis) break;
        if (refineThetas) plan.thetaStep = stepUpTo(plan.thetaStep * 0.7, rules.wholeDegrees);
        if (refinePsis) plan.psiStep = stepUpTo(plan.psiStep * 0.7, rules.wholeDegrees);
    }
    if (rules.wholeDegrees) return plan;
    if (plan.thetas.empty()) plan = detailed(plan, &SamplingPlan::thetaStep, &LossCheck::thetasFine, view, rules);
    return detailed(plan, &SamplingPlan::psiStep, &LossCheck::psisFine, view, rules);
}

SamplingPlan coarsestPlan(Ov::RnIntensityDist& dist, const HostView& view, const SamplingRules& rules) {
    double thetaStep = stepOfFormulas;
    double psiStep = 90;
    if (const auto web = webOf(dist)) {
        thetaStep = smallestStep(web->getThetaCount(), [&](int i) { return web->getTheta(i); });
        psiStep = smallestStep(web->getPsiCount(), [&](int j) { return web->getPsi(j); });
        if (!view.axisKept()) thetaStep = psiStep = std::min(thetaStep, psiStep);
    }
    return {view.symmetry(), rules.fromPole || rules.wholeSphere ? 0 : view.firstTheta(),
            rules.wholeSphere ? 180 : view.lastTheta(), stepUpTo(thetaStep, rules.wholeDegrees),
            stepUpTo(psiStep, rules.wholeDegrees)};
}

}  // namespace

HostView::HostView(const Ov::RnIntensityDist& dist) : _dist(dist), _symmetry(PhotoWebSymmetry::Full) {
    const auto orientation = dist.getOrientation();
    _axisKept = std::fabs(orientation[8] - 1) < 1e-6f;
    if (!_axisKept) return;
    _turn = std::round(inDegrees(std::atan2(double{orientation[1]}, double{orientation[0]})) * 1e4) / 1e4;
    _symmetry = turned(dist.getSymmetry(), _turn);
    _thetas = dist.getThetaRange();
    if (compareAngles(_thetas.last, halfPi) <= 0)
        _lastTheta = 90;
    else if (compareAngles(_thetas.first, halfPi) >= 0)
        _firstTheta = 90;
}

/// Where the axis is kept: theta in radians, psi in degrees of the host frame.
float HostView::localIntensity(float theta, double psi) const {
    double local = std::fmod(psi + _turn, 360);
    if (local < 0) local += 360;
    return _dist.localIntensity(theta, toRadians(local));
}

float HostView::exactly(double theta, double psi) const {
    // At a pole that lies on the edge of light psi tells the side.
    if (!_axisKept) return _dist.intensity(toRadians(std::clamp(theta, 0.001, 179.999)), toRadians(psi));
    return localIntensity(toRadians(theta), psi);
}

float HostView::intensity(double theta, double psi) const {
    if (!_axisKept) return exactly(theta, psi);
    float inRange = toRadians(theta);
    for (const float end : {_thetas.first, _thetas.last})
        if (compareAngles(inRange, end) == 0) inRange = std::clamp(inRange, _thetas.first, _thetas.last);
    return localIntensity(inRange, psi);
}

/// Whether light that one direction gets and the other does not ends between them at once, not little by little.
bool HostView::jumps(double litTheta, double litPsi, double darkTheta, double darkPsi) const {
    constexpr int halvings = 16;
    constexpr double faint = 0.005;  // of the peak
    for (int k = 0; k < halvings; ++k) {
        const double theta = std::midpoint(litTheta, darkTheta);
        const double psi = std::midpoint(litPsi, darkPsi);
        const bool lit = exactly(theta, psi) > 0;
        (lit ? litTheta : darkTheta) = theta;
        (lit ? litPsi : darkPsi) = psi;
    }
    return intensity(litTheta, litPsi) > faint * _dist.getPeakIntensity();
}

float HostView::overCell(double theta, double psi, const SamplingPlan& plan) const {
    // The cell reaches half a step to each side; look whether a hard edge of light crosses it.
    const float here = intensity(theta, psi);
    const double first = std::max(theta - plan.thetaStep / 2, plan.firstTheta);
    const double last = std::min(theta + plan.thetaStep / 2, plan.lastTheta);
    bool crossed = false;
    for (const double t : {first, theta, last})
        for (const double p : {psi - plan.psiStep / 2, psi, psi + plan.psiStep / 2}) {
            const bool lit = exactly(t, p) > 0;
            if (lit != (here > 0)) crossed = crossed || (lit ? jumps(t, p, theta, psi) : jumps(theta, psi, t, p));
        }
    if (!crossed) return here;

    // The mean over the cell, by solid angle.
    constexpr int parts = 10;
    double sum = 0;
    double weights = 0;
    for (int i = 0; i < parts; ++i) {
        const double t = std::lerp(first, last, (i + 0.5) / parts);
        const double weight = std::sin(inRadians(t));
        for (int j = 0; j < parts; ++j) {
            sum += weight * exactly(t, psi + plan.psiStep * ((j + 0.5) / parts - 0.5));
            weights += weight;
        }
    }
    return static_cast<float>(sum / weights);
}

double SamplingPlan::lastPsi() const { return psiExtentInDegrees(symmetry); }

SamplingPlan planSampling(Ov::RnIntensityDist& dist, const SamplingRules& rules) {
    const HostView view(dist);
    return refined(coarsestPlan(dist, view, rules), view, rules);
}

RnRef<Ov::RnPhotoWebData> evenPlanes(Ov::RnIntensityDist& dist) {
    const HostView view(dist);
    const auto web = webOf(dist);
    if (!web || !view.axisKept()) return {};
    SamplingPlan plan = coarsestPlan(dist, view, {});
    for (int i = 0; i < web->getThetaCount(); ++i) plan.thetas.push_back(inDegrees(web->getTheta(i)));
    plan = refined(std::move(plan), view, {});
    // Light that ends between the angles does so elsewhere on other planes.
    if (!LossCheck(view, plan, false).thetasFine()) return {};
    return Ov::rnCreate<PlannedWeb>(view, plan, false);
}

CandelaGrid sampledGrid(const Ov::RnIntensityDist& dist, const SamplingPlan& plan) {
    const HostView view(dist);
    CandelaGrid grid;
    grid.verticalCount = plan.thetaCount();
    grid.horizontalCount = plan.psiCount();
    for (int i = 0; i < grid.verticalCount; ++i) grid.verticalAngles.push_back(static_cast<float>(plan.theta(i)));
    for (int j = 0; j < grid.horizontalCount; ++j) {
        grid.horizontalAngles.push_back(static_cast<float>(plan.psi(j)));
        const double psi = plan.psi(j) < 360 ? plan.psi(j) : 0;
        for (int i = 0; i < grid.verticalCount; ++i)
            grid.candelas.push_back(view.overCell(plan.theta(i), psi, plan));
    }
    return grid;
}

}  // namespace OvPhotometrics
