#pragma once

#include "components/photo/files/candelaGrid.h"

// Candelas of any distribution on an even grid, for files that other programs read.

namespace OvPhotometrics {

struct SamplingPlan;

/// A distribution in the host frame, by angles in degrees. A turn about the axis is made by adding angles, so that
/// the edges of dark ranges stay where they are; light that ends within 0.25 degree of an angle reaches it.
class HostView {
public:
    explicit HostView(const Ov::RnIntensityDist& dist);

    float intensity(double theta, double psi) const;
    /// What an angle of an even grid stands for: the intensity there or, where a rim of bright light runs through
    /// the cell around it, the mean over the cell, which keeps the flux.
    float overCell(double theta, double psi, const SamplingPlan& plan) const;
    /// Of the host frame; Full where the axis is laid down.
    PhotoWebSymmetry symmetry() const { return _symmetry; }
    /// The part of 0 to 180 degrees that light is in: its upper or lower half, or all of it.
    double firstTheta() const { return _firstTheta; }
    double lastTheta() const { return _lastTheta; }
    bool axisKept() const { return _axisKept; }

private:
    float localIntensity(float theta, double psi) const;
    float exactly(double theta, double psi) const;
    bool jumps(double litTheta, double litPsi, double darkTheta, double darkPsi) const;

    const Ov::RnIntensityDist& _dist;
    bool _axisKept = true;
    double _turn = 0;  // degrees
    AngleRange _thetas;
    PhotoWebSymmetry _symmetry;
    double _firstTheta = 0;
    double _lastTheta = 180;
};

/// A grid in degrees, both ends included. Steps divide 90.
struct SamplingPlan {
    PhotoWebSymmetry symmetry = PhotoWebSymmetry::Full;
    double firstTheta = 0;
    double lastTheta = 180;
    double thetaStep = 1;
    double psiStep = 1;
    std::vector<double> thetas = {};  // where they are not even

    /// The end of the horizontal range: 0, 90, 180 or 360.
    double lastPsi() const;
    int thetaCount() const {
        return thetas.empty() ? static_cast<int>((lastTheta - firstTheta) / thetaStep + 0.5) + 1
                              : static_cast<int>(thetas.size());
    }
    int psiCount() const { return static_cast<int>(lastPsi() / psiStep + 0.5) + 1; }
    double theta(int i) const {
        return thetas.empty() ? firstTheta + i * thetaStep : thetas[static_cast<std::size_t>(i)];
    }
    double psi(int j) const { return j * psiStep; }
};

/// What a format's even grids are like.
struct SamplingRules {
    bool wholeDegrees = false;  // of steps
    bool fromPole = false;      // theta starts at 0
    bool wholeSphere = false;   // theta runs from 0 to 180
    bool planeKept = false;     // readers keep the plane that closes the circle
};

/// A grid for `dist`: its steps are at most the smallest of its web, and fine enough to lose less than 0.1 % of the
/// peak between the angles where 1 degree can or, on a grid of at most 65536 values, 0.05 degree. Throws
/// std::bad_alloc.
SamplingPlan planSampling(Ov::RnIntensityDist& dist, const SamplingRules& rules = {});

/// Candela on a grid as planned.
CandelaGrid sampledGrid(const Ov::RnIntensityDist& dist, const SamplingPlan& plan);

/// A web of the host frame with the vertical angles of the web that `dist` holds, and even planes as planned; null
/// when there is none, its axis is not the host's, or that loses light. Throws std::bad_alloc.
RnRef<Ov::RnPhotoWebData> evenPlanes(Ov::RnIntensityDist& dist);

}  // namespace OvPhotometrics
