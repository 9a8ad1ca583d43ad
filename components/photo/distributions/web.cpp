#include "components/photo/distributions/web.h"

#include <algorithm>
#include <limits>

#include "components/photo/distributions/singlePrecision.h"
#include "host/componentManager/stream.h"

namespace OvPhotometrics {

namespace {

GeVector3<float> unitVector(float theta, float psi) {
    const float s = single::sine(theta);
    GeVector3<float> direction{s * single::cosine(psi), s * single::sine(psi), single::cosine(theta)};
    return direction.normalize();
}

GeVector3<float> vectorAt(const float* v) { return {v[0], v[1], v[2]}; }

}  // namespace

float Web::intensity(float theta, float psi) const { return intensityAtUnit(unitVector(theta, psi)); }

float Web::intensityAt(const Vector& direction) const {
    return _maxCandela > 0 ? localIntensityAtUnit(fromHost(direction)) : 0;
}

float Web::intensityAtUnit(const Vector& direction) const {
    return _maxCandela > 0 ? localIntensityAtUnit(fromHostUnit(direction)) : 0;
}

float Web::localIntensity(float theta, float psi) const {
    return _maxCandela > 0 ? candelaOf(_web->getIntensity(theta, psi)) : 0;
}

float Web::localIntensityAt(const Vector& direction) const {
    return _maxCandela > 0 ? localIntensityAtUnit(direction.normalized()) : 0;
}

float Web::localIntensityAtUnit(const Vector& direction) const {
    float theta, psi;
    return _maxCandela > 0 && anglesOf(direction, theta, psi) ? localIntensity(theta, psi) : 0;
}

bool Web::getIntensities(DirectionForm form, const float* directions, std::int64_t wanted, float* out) const {
    const auto count = static_cast<std::size_t>(wanted);
    // Other webs, and dark ones, are asked direction by direction.
    const auto web = Ov::rnQuery<RnBasePhotoWebData>(_web.get());
    if (!web || !(_maxCandela > 0)) return false;

    // Each form as vectors of the web's frame, but for the angles of that frame, which the web takes as they are.
    const auto vectors = [&](std::size_t floats, auto convert) {
        intensitiesOfVectors(*web, directions, floats, count, out, convert);
        return true;
    };
    switch (form) {
        case DirectionForm::angles:
            return vectors(2, [this](const float* d) { return fromHostUnit(unitVector(d[0], d[1])); });
        case DirectionForm::vectors:
            return vectors(3, [this](const float* d) { return fromHost(vectorAt(d)); });
        case DirectionForm::unitVectors:
            return vectors(3, [this](const float* d) { return fromHostUnit(vectorAt(d)); });
        case DirectionForm::localAngles:
            web->getIntensities(directions, count, out);
            for (std::size_t k = 0; k < count; ++k) out[k] = candelaOf(out[k]);
            return true;
        case DirectionForm::localVectors:
            return vectors(3, [](const float* d) { return vectorAt(d).normalized(); });
        case DirectionForm::localUnitVectors:
            return vectors(3, vectorAt);
    }
    return false;
}

template <class ToLocal>
void Web::intensitiesOfVectors(const RnBasePhotoWebData& web, const float* directions, std::size_t floats,
                               std::size_t count, float* out, ToLocal convert) const {
    constexpr std::size_t together = 256;
    float angles[together * 2];
    bool reached[together];
    for (std::size_t done = 0; done < count; done += together) {
        const std::size_t group = std::min(together, count - done);
        for (std::size_t k = 0; k < group; ++k) {
            float* const to = angles + 2 * k;
            to[0] = to[1] = 0;
            reached[k] = anglesOf(convert(directions + floats * (done + k)), to[0], to[1]);
        }
        web.getIntensities(angles, group, out + done);
        for (std::size_t k = 0; k < group; ++k) out[done + k] = reached[k] ? candelaOf(out[done + k]) : 0;
    }
}

float Web::candelaOf(float relative) const {
    return orDark(std::min(_multiplier * relative, std::numeric_limits<float>::max()));
}

GeVector3<float> Web::fromHost(const Vector& direction) const {
    const Vector unit = direction.normalized();
    Vector local;
    return _identityOrientation ? unit : _web->toWebFrameUnit(local, direction);
}

GeVector3<float> Web::fromHostUnit(const Vector& direction) const {
    Vector local;
    return _identityOrientation ? direction : _web->toWebFrame(local, direction);
}

bool Web::anglesOf(const Vector& local, float& theta, float& psi) const {
    const float z = std::clamp(local.z, -1.0f, 1.0f);
    if (_cosLast > z || z > _cosFirst) return false;
    theta = single::arcCosine(z);
    const bool onAxis = local.x == 0 && local.y == 0;
    psi = onAxis ? 0 : single::arcTangent(local.y, local.x);
    return true;
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
    return {0, psiExtent(_web->getSymmetry())};
}

void Web::setWeb(Ov::RnCastable* web) { hold(Ov::rnQuery<Ov::RnPhotoWebData>(web)); }

void Web::hold(RnRef<Ov::RnPhotoWebData> web) {
    _web = std::move(web);
    _maxCandela = _web ? _web->getMaxCandela() : 0;
    _fluxFactor = _web ? lumensPerCandela(_web->getLumens(), _maxCandela) : 0;
    _identityOrientation = _web ? _web->hasIdentityOrientation() : true;
    if (!_web) return;
    const AngleRange thetas = _web->getThetaRange();
    _cosLast = single::cosine(thetas.last);
    _cosFirst = single::cosine(thetas.first);
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
