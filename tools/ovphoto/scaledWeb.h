#pragma once

#include "host/componentManager/castImpl.h"
#include "ovphoto/photoWebData.h"

namespace OvTool {

/// Another web with its candela and its flux multiplied.
class ScaledWeb final : public Ov::RnCastHeap<Ov::RnCastImpl<Ov::RnPhotoWebData, Ov::RnPhotoWebData>> {
public:
    ScaledWeb(Ov::RnRef<Ov::RnPhotoWebData> web, float candelaFactor, float fluxFactor)
        : _web(std::move(web)), _candelaFactor(candelaFactor), _fluxFactor(fluxFactor) {}

    float getMaxCandela() const override { return _web->getMaxCandela() * _candelaFactor; }
    float getLumens() const override { return _web->getLumens() * _fluxFactor; }
    Ov::RnRef<Ov::RnPhotoWebData> clone() const override {
        return Ov::rnCreate<ScaledWeb>(_web->clone(), _candelaFactor, _fluxFactor);
    }

    // As the other web answers.
    bool isLoaded() const override { return _web->isLoaded(); }
    const wchar_t* getName() const override { return _web->getName(); }
    Ov::PhotoWebSymmetry getSymmetry() const override { return _web->getSymmetry(); }
    bool hasIdentityOrientation() const override { return _web->hasIdentityOrientation(); }
    Ov::GeLinearMatrix3<float> getOrientation() const override { return _web->getOrientation(); }
    Ov::GeVector3<float>& toWebFrame(Ov::GeVector3<float>& out,
                                     const Ov::GeVector3<float>& direction) const override {
        return _web->toWebFrame(out, direction);
    }
    Ov::GeVector3<float>& toWebFrameUnit(Ov::GeVector3<float>& out,
                                         const Ov::GeVector3<float>& direction) const override {
        return _web->toWebFrameUnit(out, direction);
    }
    bool isPsiTruncated() const override { return _web->isPsiTruncated(); }
    Ov::AngleRange getThetaRange() const override { return _web->getThetaRange(); }
    Ov::AngleRange getPsiRange() const override { return _web->getPsiRange(); }
    int findTheta(float angle) const override { return _web->findTheta(angle); }
    int findPsi(float angle) const override { return _web->findPsi(angle); }
    int getThetaCount() const override { return _web->getThetaCount(); }
    float getTheta(int index) const override { return _web->getTheta(index); }
    int getPsiCount() const override { return _web->getPsiCount(); }
    float getPsi(int index) const override { return _web->getPsi(index); }
    float getCandela(int psiIndex, int thetaIndex) const override {
        return _web->getCandela(psiIndex, thetaIndex);
    }
    void getCandelaBlock(Ov::IndexRange psis, Ov::IndexRange thetas, float* out) const override {
        _web->getCandelaBlock(psis, thetas, out);
    }
    Ov::RnEnum::Action enumerateFiles(Ov::RnEnumerator<const wchar_t*>& visitor) const override {
        return _web->enumerateFiles(visitor);
    }
    float getIntensity(float theta, float psi) const override { return _web->getIntensity(theta, psi); }

private:
    Ov::RnRef<Ov::RnPhotoWebData> _web;
    float _candelaFactor;
    float _fluxFactor;
};

}  // namespace OvTool
