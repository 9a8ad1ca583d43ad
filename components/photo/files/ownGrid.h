#pragma once

#include "components/photo/files/candelaGrid.h"

// A light as candelas in a file for other programs, where the file can hold angles: on its web's own angles if it can
// hold them and their orientation.

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
bool isTurned(const Ov::RnPhotoWebData& web, const GeLinearMatrix3<float>& turned, float tolerance = 1e-5f);

/// Copies a web's grid, its values times `peak`, so that the format's reader makes the same light of it: shifted back
/// to where the reader shifts it from, each angle with as few decimals as give it back exactly. A full circle is
/// closed with plane 360. Where the light ends at a rim within the range that the format wants, angles 0.001 degree
/// apart lead into the dark; a rim at the end of that range moves inwards by 0.003. False when the format cannot hold
/// the web's layout or orientation. Throws std::bad_alloc.
bool ownGrid(const Ov::RnPhotoWebData& web, float peak, const OwnGridRules& rules, FileGrid& out);

/// What a faithful file holds: the own grid where that can be; else the distribution in the host frame on even
/// planes, with its own vertical angles if its axis stands upright. Throws std::bad_alloc.
FileGrid faithfulGrid(Ov::RnIntensityDist& dist, const OwnGridRules& rules);

/// Multiplies all candelas by `unit` and the least power of ten that gives the peak six digits or more with two
/// decimals, which they are rounded to. What turns the values back into candela.
float scaleForFile(CandelaGrid& grid, double unit);

}  // namespace OvPhotometrics
