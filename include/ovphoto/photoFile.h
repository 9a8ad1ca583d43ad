#pragma once

#include <cmath>

#include "ovphoto/photoWebData.h"

// What files are beyond their webs: how they count angles, and what candela and lumens their values stand for.

namespace Ov {

/// How the file of a web counts its angles, and what its numbers mean.
///
/// Units:    degrees for the angles of the file, radians for those of the web's own frame; lumens.
struct PhotoFileInfo {
    /// What the peak of the web, RnPhotoWebData::getMaxCandela, is multiplied by to be candela.
    float candelaFactor = 1;
    /// What the lamps give off; 0 where the file does not say.
    float lampLumens = 0;
    /// Added to the file's vertical angles for theta.
    float verticalShift = 0;
    /// Added to its horizontal angles for psi.
    float horizontalShift = 0;
    /// The file's last horizontal angle where that plane repeats the first and the web goes without; else 0.
    float closingPlane = 0;
    /// Whether its planes go through a horizontal axis (types A and B of IES, type 2 of CIBSE); vertical and
    /// horizontal angle 0 are then the axis that it shines along.
    bool lateral = false;

    /// @{
    /// The angle of the web's own frame: exactly that of the web's list for an angle of the file's list.
    float theta(double vertical) const { return inRadians(vertical + verticalShift); }
    float psi(double horizontal) const {
        double angle = horizontal + horizontalShift;
        if (!(std::fabs(angle) < 720)) angle = std::fmod(angle, 360);
        while (angle < -0.5) angle += 360;  // planes from 270 run on through 0
        return inRadians(angle);
    }
    /// @}

    /// @{
    /// The angle of the file, degrees, as exactly as double can tell.
    double vertical(float theta) const { return inDegrees(theta) - verticalShift; }
    double horizontal(float psi) const {
        const double angle = inDegrees(psi) - horizontalShift;
        return horizontalShift < 0 && angle >= 360 ? angle - 360 : angle;
    }
    /// @}

private:
    static float inRadians(double degrees) { return static_cast<float>(degrees * 3.14159265358979323846 / 180.0); }
    static double inDegrees(float radians) { return radians * 180.0 / 3.14159265358979323846; }
};

/// A web that knows its file. The webs of this module answer it; one that nothing was read into says what
/// PhotoFileInfo says by itself.
class RnPhotoFileWeb : public RnPhotoWebData {
public:
    /// Id of the interface.
    static constexpr RnUid iid{0x7c1e9f20, 0x4a5b11ef, 0x9c6e0b62, 0x5d83a4f7};

    /// Of the file that was read last.
    virtual const PhotoFileInfo& getFileInfo() const = 0;
    /// The flux of the luminaire in lumens: the integral over the web of its candela, with the file's factor. It
    /// may be below 0 where values are. Takes a walk over the grid.
    virtual float getLuminaireLumens() const = 0;
    /// The web with its peak in candela and with the lamps' lumens or, where the file has none, the luminaire's:
    /// itself where it is so, else another of the same name.
    virtual RnRef<RnPhotoWebData> inCandela() = 0;
};

}  // namespace Ov
