#pragma once

#include "components/photo/lid/candelaGrid.h"

// A web's own grid as candelas in a file for other programs, where the file can hold angles and orientation.

namespace OvPhotometrics {

/// How the angles of a file's grid lie: planes through the vertical axis; planes through a horizontal axis, their
/// angles measured upright; or the same with the axis laid down (types C, A and B of IES).
enum class GridFrame { polar, upright, laidDown };

struct FileGrid {
    CandelaGrid grid;  // degrees and candela
    GridFrame frame = GridFrame::polar;
};

/// What a format's reader makes of a grid.
struct OwnGridRules {
    float tolerance;        // degrees that an outer angle may lie off the value it stands for
    bool wraps;             // polar planes may run from 270 through 360
    bool lateralTruncated;  // beyond the last angle of a lateral grid it is dark
    bool uprightTurned;     // an upright grid may have angles to both sides of 0
};

/// Whether a web has the orientation that `turned`, a record's, gives it.
bool isTurned(const Ov::RnPhotoWebData& web, const GeLinearMatrix3<float>& turned);

/// Copies the grid of the web that `dist` holds, shifted back to where the format's reader shifts it from; a full
/// circle is closed with plane 360. False when there is no web, an angle is no multiple of 0.01 degree or the
/// format cannot hold the web's layout or orientation. Throws std::bad_alloc.
bool ownGrid(Ov::RnIntensityDist& dist, const OwnGridRules& rules, FileGrid& out);

/// What a faithful file holds: the own grid where that can be, else the distribution sampled in the host frame.
/// Throws std::bad_alloc.
FileGrid faithfulGrid(Ov::RnIntensityDist& dist, const OwnGridRules& rules);

/// Multiplies all candelas by `unit` and the least power of ten that gives the peak six digits or more with the
/// two decimals that are written. What turns the values back into candela.
float scaleForFile(CandelaGrid& grid, double unit);

}  // namespace OvPhotometrics
