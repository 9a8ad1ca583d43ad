#include "components/photo/lid/sampling.h"

#include <algorithm>
#include <cmath>

#include "components/photo/lid/webDistribution.h"
#include "host/componentManager/castImpl.h"

namespace OvPhotometrics {

namespace {

constexpr double finest = 1;            // degrees
constexpr double stepOfFormulas = 5;    // where no web says how fine a distribution is
constexpr double allowedLoss = 0.0007;  // of the peak, midway on the edges of a cell; inside it is a little more
constexpr double sameAngle = 0.005;     // degrees

double endOf(PhotoWebSymmetry symmetry) {
    switch (symmetry) {
        case PhotoWebSymmetry::Full:
            return 360;
        case PhotoWebSymmetry::Half:
            return 180;
        case PhotoWebSymmetry::Quarter:
            return 90;
        case PhotoWebSymmetry::Axial:
            break;
    }
    return 0;
}

/// What is left of a symmetry after a turn about the axis.
PhotoWebSymmetry turned(PhotoWebSymmetry symmetry, double degrees) {
    const auto multipleOf = [&](double angle) { return std::fabs(std::remainder(degrees, angle)) < sameAngle; };
    const bool kept = symmetry == PhotoWebSymmetry::Axial ||
                      (symmetry == PhotoWebSymmetry::Quarter && multipleOf(90)) ||
                      (symmetry == PhotoWebSymmetry::Half && multipleOf(180));
    return kept ? symmetry : PhotoWebSymmetry::Full;
}

/// The largest step up to `limit` degrees that divides 90 and is a multiple of 0.01, or of 1.
double stepUpTo(double limit, bool wholeDegrees) {
    for (int parts = 1; parts < 90; ++parts)
        if ((wholeDegrees ? 90 : 9000) % parts == 0 && 90.0 / parts <= limit + sameAngle) return 90.0 / parts;
    return finest;
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
class PlannedWeb final : public Ov::RnCastImpl<RnBasePhotoWebData, Ov::RnPhotoWebData> {
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
        return _maxCandela * getIntensity(toRadians(theta), toRadians(psi));
    }
};

/// Whether a plan keeps what lies midway between its angles, in one direction or the other.
class LossCheck {
public:
    LossCheck(const HostView& view, const SamplingPlan& plan, bool planeKept)
        : _view(view), _plan(plan), _web(view, plan, planeKept) {}

    bool thetasFine() const {
        for (int j = 0; j < _plan.psiCount(); ++j)
            for (int i = 0; i + 1 < _plan.thetaCount(); ++i)
                if (loses(_plan.theta(i) + _plan.thetaStep / 2, _plan.psi(j))) return false;
        return true;
    }
    bool psisFine() const {
        for (int j = 0; j + 1 < _plan.psiCount(); ++j)
            for (int i = 0; i < _plan.thetaCount(); ++i)
                if (loses(_plan.theta(i), _plan.psi(j) + _plan.psiStep / 2)) return false;
        return true;
    }

private:
    bool loses(double theta, double psi) const {
        const double loss =
            std::fabs(static_cast<double>(_view.intensity(theta, psi)) - _web.intensity(theta, psi));
        return loss > allowedLoss * _web.getMaxCandela();
    }

    const HostView& _view;
    const SamplingPlan& _plan;
    PlannedWeb _web;
};

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
    _turn = std::round(inDegrees(std::atan2(double{orientation[1]}, double{orientation[0]})) * 100) / 100;
    _symmetry = turned(dist.getSymmetry(), _turn);
    _thetas = dist.getThetaRange();
    if (compareAngles(_thetas.last, halfPi) <= 0)
        _lastTheta = 90;
    else if (compareAngles(_thetas.first, halfPi) >= 0)
        _firstTheta = 90;
}

float HostView::intensity(double theta, double psi) const {
    // At a pole that lies on the edge of light psi tells the side.
    if (!_axisKept) return _dist.intensity(toRadians(std::clamp(theta, 0.001, 179.999)), toRadians(psi));
    double local = std::fmod(psi + _turn, 360);
    if (local < 0) local += 360;
    float inRange = toRadians(theta);
    for (const float end : {_thetas.first, _thetas.last})
        if (compareAngles(inRange, end) == 0) inRange = std::clamp(inRange, _thetas.first, _thetas.last);
    return _dist.localIntensity(inRange, toRadians(local));
}

double SamplingPlan::lastPsi() const { return endOf(symmetry); }

SamplingPlan planSampling(Ov::RnIntensityDist& dist, const SamplingRules& rules) {
    const HostView view(dist);
    SamplingPlan plan = coarsestPlan(dist, view, rules);
    for (;;) {
        const LossCheck check(view, plan, rules.planeKept);
        const bool refineThetas = plan.thetaStep > finest && !check.thetasFine();
        const bool refinePsis = plan.psiStep > finest && !check.psisFine();
        if (!refineThetas && !refinePsis) return plan;
        if (refineThetas) plan.thetaStep = stepUpTo(plan.thetaStep * 0.7, rules.wholeDegrees);
        if (refinePsis) plan.psiStep = stepUpTo(plan.psiStep * 0.7, rules.wholeDegrees);
    }
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
        for (int i = 0; i < grid.verticalCount; ++i) grid.candelas.push_back(view.intensity(plan.theta(i), psi));
    }
    return grid;
}

}  // namespace OvPhotometrics
