#pragma once

#include <array>

#include "ovphoto/naturalLight.h"
#include "plot/caption.h"

// Pictures of natural light. The zenith is in the middle, the horizon a circle around it, and an altitude as far
// from it as it is high.

namespace OvPlot {

/// What a picture says by itself.
struct SkyWords {
    const char* east = "E";
    const char* to = " to ";  // between dates
    const char* hours = "hours of the clock";
    const char* setDay = "the set day";
    const char* dark = "no light from the sky";
    const char* dayEnd = " ";  // behind the day of a date
};

struct SkyCaption {
    std::string title;
    std::string subtitle;
    std::vector<std::string> notes;
    SkyWords words = {};
};

/// The sky's luminance as one sees it who looks up with north on top: east is on the left.
void drawSky(Canvas& canvas, Ov::RnNaturalLight& daylight, const SkyCaption& caption);

/// The sun's ways over the site on the 21st of each month and on the set day, and where it stands at each hour of
/// the clock, as on a map: east is on the right. `months` are short names.
void drawSunPath(Canvas& canvas, Ov::RnNaturalLight& daylight, const SkyCaption& caption,
                 const std::array<std::string, 12>& months);

}  // namespace OvPlot
