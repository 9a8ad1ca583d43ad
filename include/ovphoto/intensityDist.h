#pragma once

#include "host/componentManager/castable.h"
#include "host/primitives/geLinearMatrix3.h"
#include "host/primitives/geVector3.h"
#include "ovphoto/photoTypes.h"
#include "ovphoto/photoWebData.h"

namespace Ov {

/// How much light a source sends in every direction.
///
/// Frames:   directions are given in the host frame or, in the `local` operations, in the distribution's own.
///           Both have the axis +Z, theta from +Z (0 to pi) and psi around Z from +X towards +Y; they differ only
///           for a web distribution whose web is turned.
/// Units:    candela, lumens, radians.
/// Errors:   a zero vector raises the assertion "len > 0" where a direction is normalised.
/// Threads:  any number may ask, clone and save a distribution at once that nobody changes.
class RnIntensityDist : public RnCastable {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x1a3aa361, 0xb3bd11d1, 0xa3e70060, 0x9707609d};

    /// This same object with a new reference.
    virtual RnRef<RnIntensityDist> reference() = 0;
    /// A new, independent copy.
    virtual RnRef<RnIntensityDist> clone() const = 0;

    /// @{
    /// Host frame: towards angles, a direction of any length but 0, a unit direction.
    virtual float intensity(float theta, float psi) const = 0;
    virtual float intensityAt(const GeVector3<float>& direction) const = 0;
    virtual float intensityAtUnit(const GeVector3<float>& direction) const = 0;
    /// @}

    /// @{
    /// The same in the distribution's frame.
    virtual float localIntensity(float theta, float psi) const = 0;
    virtual float localIntensityAt(const GeVector3<float>& direction) const = 0;
    virtual float localIntensityAtUnit(const GeVector3<float>& direction) const = 0;
    /// @}

    /// False in every distribution of this library.
    virtual bool query() const = 0;
    /// How the horizontal angles stand for the whole circle.
    virtual PhotoWebSymmetry getSymmetry() const = 0;

    /// @{
    /// The intensity parameter: the peak intensity in candela; for a web distribution the candela that stand for
    /// a relative value of 1.
    virtual float getPeakIntensity() const = 0;
    virtual void setPeakIntensity(float candela) = 0;
    /// @}

    /// @{
    /// Total flux in lumens. Setting it sets the intensity parameter accordingly.
    virtual float getFlux() const = 0;
    virtual void setFlux(float lumens) = 0;
    /// @}

    /// Whether host frame and own frame are the same.
    virtual bool hasIdentityOrientation() const = 0;
    /// The matrix that `toLocal` applies to a direction of the host frame.
    virtual GeLinearMatrix3<float> getOrientation() const = 0;

    /// @{
    /// A direction of the host frame in the distribution's own; the second is of any length but 0 and normalised
    /// first.
    virtual GeVector3<float> toLocal(const GeVector3<float>& unitDirection) const = 0;
    virtual GeVector3<float> toLocalNormalized(const GeVector3<float>& direction) const = 0;
    /// @}

    /// @{
    /// The angles that can carry light.
    virtual AngleRange getThetaRange() const = 0;
    virtual AngleRange getPsiRange() const = 0;
    /// @}

    /// For the host's use; does nothing.
    virtual void hook() = 0;
};

/// The same intensity everywhere.
class RnIsotropicIntensityDist : public RnIntensityDist {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x1a3aa362, 0xb3bd11d1, 0xa3e70060, 0x9707609d};
};

/// Light in proportion to the cosine of the angle to the axis, and none behind.
class RnDiffuseIntensityDist : public RnIntensityDist {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x1a3aa363, 0xb3bd11d1, 0xa3e70060, 0x9707609d};
};

/// A beam around the axis: a power of the cosine that is down to half at the hotspot angle, and nothing beyond the
/// falloff angle. A hotspot of less than about 0.1 degree gives no light.
class RnSpotlightIntensityDist : public RnIntensityDist {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x1a3aa364, 0xb3bd11d1, 0xa3e70060, 0x9707609d};

    /// @{
    /// The cosines of the two angles.
    virtual float getHotspotCosine() const = 0;
    virtual float getFalloffCosine() const = 0;
    /// @}

    /// @{
    /// Both keep the intensity, so that the flux changes. A cosine outside its limits, or NaN, is stored as a
    /// limit: hotspots up to about 89 degrees (0.01745328 and more), falloffs from about 0.1 to 90 (0 to
    /// 0.99999845).
    virtual void setHotspotCosine(float cosine) = 0;
    virtual void setFalloffCosine(float cosine) = 0;
    /// @}
};

/// A photometric web placed in the light's frame. It is dark until it has a web and an intensity or flux.
class RnWebIntensityDist : public RnIntensityDist {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x1a3aa366, 0xb3bd11d1, 0xa3e70060, 0x9707609d};

    /// The web, without a new reference, or null.
    virtual RnPhotoWebData* getWeb() const = 0;
    /// Takes another web (null or something that is no web: none) and keeps the intensity parameter.
    virtual void setWeb(RnCastable* web) = 0;
};

}  // namespace Ov
