#pragma once

#include <cstdint>
#include <vector>

#include "components/photo/files/numberText.h"
#include "components/photo/lid/photoWeb.h"
#include "ovphoto/intensityDist.h"

// The grid of a luminaire file as IES and CIBSE share it: how it is read, and filled from a web or distribution.

namespace OvPhotometrics {

/// Angles in degrees and candelas as a file holds them, one row of vertical angles for each horizontal angle.
struct CandelaGrid {
    std::int32_t verticalCount = 0;
    std::int32_t horizontalCount = 0;
    std::vector<float> verticalAngles;
    std::vector<float> horizontalAngles;
    std::vector<float> candelas;

    float& candela(int vertical, int horizontal) { return candelas[index(vertical, horizontal)]; }
    float candela(int vertical, int horizontal) const { return candelas[index(vertical, horizontal)]; }

    std::size_t index(int vertical, int horizontal) const {
        return static_cast<std::size_t>(horizontal) * static_cast<std::size_t>(verticalCount) +
               static_cast<std::size_t>(vertical);
    }
};

/// At least 2 by 1 angles spread evenly over 0 to 180 and 0 to 360 degrees, every candela 0. False, and the grid
/// as it was, after message 12936.
bool candelaGridAlloc(CandelaGrid& grid, int verticalCount, int horizontalCount);

/// Reads the counts, at least 2 by 1. False after the messages of what is wrong (12960, 12961).
bool candelaGridReadCounts(CandelaGrid& grid, NumberText& in);
/// Reads angles and candelas for the counts that stand in `grid`. False after the messages of what failed (12936,
/// 12966 to 12968).
bool candelaGridRead(CandelaGrid& grid, NumberText& in);

/// Writes vertical angles, horizontal angles and each row of candelas as value lists.
void candelaGridWrite(const CandelaGrid& grid, Ov::RnStream& out, int limit, FileForm form);

/// How a web's own grid can stand in a file: as planes through the vertical axis, as angles centred on 0 or to one
/// side of it, or not at all.
enum class GridFit { polar, lateral, none };
GridFit gridFit(const Ov::RnPhotoWebData& web);
/// Copies a web's grid that fits: angles in degrees (a full lateral one centred on 0), relative values times
/// `factor`. False after message 12936.
bool candelaGridFromWeb(CandelaGrid& grid, const Ov::RnPhotoWebData& web, GridFit fit, float factor);
/// Whether the last plane of a half or quarter circle, 180 or 90, is sampled too.
enum class LastPlane { without, with };
/// Samples a distribution every 10 degrees: 19 vertical angles, planes from 0 over its circle, half or quarter, or
/// one plane; candela times `factor`. False after message 12936.
bool candelaGridFromSampling(CandelaGrid& grid, const Ov::RnIntensityDist& dist, LastPlane lastPlane,
                             float factor);

}  // namespace OvPhotometrics
