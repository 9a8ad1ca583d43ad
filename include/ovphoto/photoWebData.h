#pragma once

#include "host/componentManager/castable.h"
#include "host/componentManager/enumerator.h"
#include "host/primitives/geLinearMatrix3.h"
#include "host/primitives/geVector3.h"
#include "ovphoto/photoTypes.h"

namespace Ov {

/// A photometric web: luminous intensities on a grid of vertical angles theta and horizontal angles psi.
///
/// Frame:    axis +Z, theta from +Z (0 to pi), psi around Z from +X towards +Y. `getOrientation` turns a
///           direction of the light's (host) frame into the web's own.
/// Units:    radians; relative values whose peak is 1, to be multiplied by `getMaxCandela` for candela; lumens.
/// Outside:  a web is dark above its first and below its last vertical angle.
/// Empty:    a web that nothing was loaded into answers 0, the identity and empty ranges.
/// Threads:  any number may query, clone and save a loaded web at once.
class RnPhotoWebData : public RnCastable {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x1a3aa365, 0xb3bd11d1, 0xa3e70060, 0x9707609d};

    /// A new web with the same grid, flux, peak, orientation and flags; its name is empty and it does not count
    /// as loaded.
    virtual RnRef<RnPhotoWebData> clone() const = 0;
    /// Whether the web was read from a file or stream.
    virtual bool isLoaded() const = 0;
    /// Never null.
    virtual const wchar_t* getName() const = 0;
    /// How the horizontal angles stand for the whole circle.
    virtual PhotoWebSymmetry getSymmetry() const = 0;
    /// Peak intensity in candela, as the file gives it.
    virtual float getMaxCandela() const = 0;
    /// Luminous flux in lumens: as the file gives it, else integrated over the web.
    virtual float getLumens() const = 0;
    /// Whether the light's frame is the web's own.
    virtual bool hasIdentityOrientation() const = 0;
    /// The matrix that turns a direction of the light's frame into the web's own.
    virtual GeLinearMatrix3<float> getOrientation() const = 0;
    /// `direction` in the web's frame: unchanged when the orientation is the identity, else turned and
    /// normalised. A zero vector then raises the assertion "len > 0".
    virtual GeVector3<float>& toWebFrame(GeVector3<float>& out, const GeVector3<float>& direction) const = 0;
    /// The same, always normalised.
    virtual GeVector3<float>& toWebFrameUnit(GeVector3<float>& out, const GeVector3<float>& direction) const = 0;
    /// Whether nothing is emitted beyond the last horizontal angle.
    virtual bool isPsiTruncated() const = 0;

    /// @{
    /// The first and the last angle.
    virtual AngleRange getThetaRange() const = 0;
    virtual AngleRange getPsiRange() const = 0;
    /// @}

    /// @{
    /// Index of the last angle that is at most `angle`; 0 when all are above it, -1 when there are none.
    virtual int findTheta(float angle) const = 0;
    virtual int findPsi(float angle) const = 0;
    /// @}

    /// How many vertical angles there are.
    virtual int getThetaCount() const = 0;
    /// The index is clamped to those that exist.
    virtual float getTheta(int index) const = 0;
    /// How many horizontal angles are stored.
    virtual int getPsiCount() const = 0;
    /// The index is folded by symmetry; -1 and indices beyond the last stand for mirrored or repeated planes.
    virtual float getPsi(int index) const = 0;
    /// Relative value; the horizontal index comes first and is folded, the vertical one is clamped.
    virtual float getCandela(int psiIndex, int thetaIndex) const = 0;
    /// Writes the relative values of a block of indices to `out`, one row of vertical indices after another; the
    /// caller gives the space. `psis.first` lies in -1 .. count - 1 (else the assertion "h >= -1 && h < _npsis");
    /// the rows behind it wrap (Full) or reflect (Half, Quarter), vertical indices are clamped. A range whose last
    /// index lies before its first has no values.
    virtual void getCandelaBlock(IndexRange psis, IndexRange thetas, float* out) const = 0;
    /// Visits the paths of the files that the web depends on, such as a tilt file.
    virtual RnEnum::Action enumerateFiles(RnEnumerator<const wchar_t*>& visitor) const = 0;
    /// Relative intensity towards (theta, psi) in the web's frame: bicubic (Catmull-Rom) between the samples,
    /// never below 0. A direction that is not a number gives 0.
    virtual float getIntensity(float theta, float psi) const = 0;
};

}  // namespace Ov
