#pragma once

#include "components/messageFile/typedMessage.h"
#include "components/photo/files/candelaGrid.h"
#include "components/photo/lid/photoWeb.h"

// From the grid of a luminaire file to a web: which symmetry, offsets and orientation its angles imply.

namespace OvPhotometrics {

/// How the angles of a grid stand for a web.
struct WebLayout {
    PhotoWebSymmetry symmetry = PhotoWebSymmetry::Full;
    bool psiTruncated = false;
    int columns = 0;            // horizontal angles kept
    float verticalShift = 0;    // degrees, added to every vertical angle
    float horizontalShift = 0;  // degrees; not 0: the web is turned by as much
    bool lateral = false;       // planes through a horizontal axis
};

/// The tolerance of a format, in degrees, and the messages for what its layouts refuse.
struct PolarRules {
    float tolerance;
    Ov::Message<> verticalRange;
    Ov::Message<double> lastHorizontal;   // the angle
    Ov::Message<double> firstHorizontal;  // the angle
    bool from270 = false;                 // planes may start at 270 and run on through 0
};
struct LateralRules {
    float tolerance;
    Ov::Message<> verticalRange;
    Ov::Message<> horizontalCount;
    Ov::Message<> horizontalRange;
};

// Angles must not decrease (12943, 12944), but for planes from 270.

/// Planes through the vertical axis, planes 0 to 360 or a symmetric part (type C of IES, type 1 of CIBSE). False
/// after a message.
bool polarLayout(const CandelaGrid& grid, const PolarRules& rules, WebLayout& layout);
/// Planes through a horizontal axis, angles to both sides of 0 or to one (types A and B of IES, type 2 of CIBSE).
/// False after a message.
bool lateralLayout(const CandelaGrid& grid, const LateralRules& rules, WebLayout& layout);

/// Sets angles, candelas times `factor`, and how the file counts its angles, of a record started for `layout`.
void fillWebRecord(PhotoWebRecord& rec, const CandelaGrid& grid, const WebLayout& layout, float factor);

/// The turn about the vertical axis by an angle in degrees.
GeLinearMatrix3<float> turnedBy(float degrees);
/// The turn that also lays the axis down: by (degrees + 90) about the vertical, after -90 about the second axis,
/// given in radians as the format rounds it.
GeLinearMatrix3<float> laidDownBy(float degrees, double second = inRadians(-90));

}  // namespace OvPhotometrics
