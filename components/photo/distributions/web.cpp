#include "components/photo/distributions/web.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "host/componentManager/stream.h"

namespace OvPhotometrics {

namespace {

// Single-precision functions are the double ones, rounded once: platforms' own differ in the last digit.
float sine(float a) { return static_cast<float>(std::sin(static_cast<double>(a))); }
float cosine(float a) { return static_cast<float>(std::cos(static_cast<double>(a))); }

}  // namespace

float Web::intensity(float theta, float psi) const {
    const float s = sine(theta);
    GeVector3<float> direction{s * cosine(psi), s * sine(psi), cosine(theta)};
    return intensityAtUnit(direction.normalize());
}

float Web::intensityAt(const GeVector3<float>& direction) const {
    if (!(_maxCandela > 0)) return 0;
    const GeVector3<float> unit = direction.normalized();
    if (_identityOrientation) return localIntensityAtUnit(unit);
    GeVector3<float> local;
    return localIntensityAtUnit(_web->toWebFrameUnit(local, direction));
}

float Web::intensityAtUnit(const GeVector3<float>& direction) const {
    if (!(_maxCandela > 0)) return 0;
    if (_identityOrientation) return localIntensityAtUnit(direction);
    GeVector3<float> local;
    return localIntensityAtUnit(_web->toWebFrame(local, direction));
}

float Web::localIntensity(float theta, float psi) const {
    if (!(_maxCandela > 0)) return 0;
    return std::min(_multiplier * _web->getIntensity(theta, psi), std::numeric_limits<float>::max());
}

float Web::localIntensityAt(const GeVector3<float>& direction) const {
    return _maxCandela > 0 ? localIntensityAtUnit(direction.normalized()) : 0;
}

float Web::localIntensityAtUnit(const GeVector3<float>& direction) const {
    if (!(_maxCandela > 0)) return 0;
    const float z = std::clamp(direction.z, -1.0f, 1.0f);
    if (_cosLast > z || z > _cosFirst) return 0;
    const float theta = static_cast<float>(std::acos(static_cast<double>(z)));
    const bool onAxis = direction.x == 0 && direction.y == 0;
    const double psi = onAxis ? 0 : std::atan2(static_cast<double>(direction.y), static_cast<double>(direction.x));
    return localIntensity(theta, static_cast<float>(psi));
}

GeLinearMatrix3<float> Web::getOrientation() const {
    return _web ? _web->getOrientation() : GeLinearMatrix3<float>();
}

GeVector3<float> Web::toLocal(const GeVector3<float>& unitDirection) const {
    GeVector3<float> local;
    return _web ? _web->toWebFrame(local, unitDirection) : unitDirection;
}

GeVector3<float> Web::toLocalNormalized(const GeVector3<float>& direction) const {
    GeVector3<float> local;
    return _web ? _web->toWebFrameUnit(local, direction) : direction.normalized();
}

AngleRange Web::getPsiRange() const {
    if (!_web) return {};
    if (_web->isPsiTruncated()) return _web->getPsiRange();
    switch (_web->getSymmetry()) {
        case PhotoWebSymmetry::Full:
            return {0, twoPi};
        case PhotoWebSymmetry::Half:
            return {0, pi};
        case PhotoWebSymmetry::Quarter:
            return {0, halfPi};
        case PhotoWebSymmetry::Axial:
            break;
    }
    return {};
}

void Web::setWeb(Ov::RnCastable* web) { hold(Ov::rnQuery<Ov::RnPhotoWebData>(web)); }

void Web::hold(RnRef<Ov::RnPhotoWebData> web) {
    _web = std::move(web);
    _maxCandela = _web ? _web->getMaxCandela() : 0;
    _fluxFactor = _maxCandela > 0 ? _web->getLumens() / _maxCandela : 0;
    _identityOrientation = _web ? _web->hasIdentityOrientation() : true;
    if (!_web) return;
    const AngleRange thetas = _web->getThetaRange();
    _cosLast = cosine(thetas.last);
    _cosFirst = cosine(thetas.first);
}

void WebPersistant::save(Ov::RnStream& stream) {
    stream << data()._multiplier;
    stream << static_cast<const Ov::RnCastable*>(data()._web.get());
}

bool WebPersistant::load(Ov::RnStream& stream, int, const wchar_t* name, const wchar_t* basePath) {
    float multiplier = 0;
    stream >> multiplier;
    const auto object = stream.readObject(&Ov::RnPhotoWebData::iid, name, basePath);
    auto web = Ov::rnCast<Ov::RnPhotoWebData>(object.get());
    data()._multiplier = multiplier;
    data().hold(std::move(web));
    return true;
}

}  // namespace OvPhotometrics
