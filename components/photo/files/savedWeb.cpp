#include "components/photo/files/savedWeb.h"

#include <algorithm>
#include <atomic>
#include <cmath>

namespace OvPhotometrics {

namespace {

std::atomic<bool> isFaithful = false;

constexpr double tolerance = 1e-5;
constexpr double valueTolerance = 6e-6;  // of the peak: between samples, cubics make up to 1.5625 of it
constexpr double turnTolerance = 1e-7;   // of an element of the orientation: its last bit

bool isNear(double a, double b, double size) { return std::fabs(a - b) <= tolerance * size; }

bool sameAngles(const WebGrid& a, const WebGrid& b) {
    return a.nthetas == b.nthetas && a.npsis == b.npsis && a.symmetry == b.symmetry &&
           a.psiTruncated == b.psiTruncated && std::equal(a.thetas, a.thetas + a.nthetas, b.thetas) &&
           std::equal(a.psis, a.psis + a.npsis, b.psis);
}

bool sameTurn(const RnBasePhotoWebData& a, const RnBasePhotoWebData& b) {
    const auto first = a.getOrientation();
    const auto second = b.getOrientation();
    return std::equal(first.values().begin(), first.values().end(), second.values().begin(),
                      [](double x, double y) { return std::fabs(x - y) <= turnTolerance; });
}

bool sameValues(const WebGrid& a, const WebGrid& b) {
    const auto count = static_cast<std::size_t>(a.nthetas) * static_cast<std::size_t>(a.npsis);
    return std::equal(a.values, a.values + count, b.values,
                      [](double x, double y) { return std::fabs(x - y) <= valueTolerance; });
}

}  // namespace

bool websAreSavedFaithfully() { return isFaithful; }

void saveWebsFaithfully(bool faithful) { isFaithful = faithful; }

bool keepsLight(const RnBasePhotoWebData& web, const RnBasePhotoWebData& again) {
    const double peak = web.getMaxCandela();
    if (!(peak > 0)) return !(again.getMaxCandela() > 0);  // dark everywhere
    const double lumens = web.getLumens();
    const double sphere = 4.0 * pi * peak;
    return sameAngles(web.grid(), again.grid()) && sameTurn(web, again) && sameValues(web.grid(), again.grid()) &&
           isNear(again.getMaxCandela(), peak, peak) &&
           isNear(again.getLumens(), lumens, std::max(std::fabs(lumens), sphere));
}

}  // namespace OvPhotometrics
