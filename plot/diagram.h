#pragma once

#include <optional>
#include <string>
#include <vector>

#include "plot/canvas.h"
#include "plot/luminaireFrame.h"

// Diagrams of luminaires. They follow the conventions of the field: gamma 0 points down, planes C count anticlockwise
// around the axis as seen from above, and every intensity is asked of the distribution, between its samples too.
// Nothing here knows of files.

namespace OvPlot {

/// A luminaire and what is said of it.
struct Subject {
    const Ov::RnIntensityDist* luminaire = nullptr;
    LuminaireFrame frame;
    std::string name;
    std::vector<std::string> notes;               // such as "Peak 2150 cd"
    std::vector<std::optional<AngleSpan>> beams;  // in C0-C180 and in C90-C270: down to half of the peak

    float intensity(double gamma, double c) const { return intensityTowards(*luminaire, frame.direction(gamma, c)); }
};

struct Diagram {
    std::string title;
    std::vector<Subject> subjects;      // one at least
    std::vector<double> planes{0, 90};  // C of the planes shown, each with C + 180
    std::optional<double> height;       // of the luminaire over the plane that it lights, or the farthest one, m
};

/// @{
/// Intensities in planes through the axis, of one luminaire or several.
void drawPolar(Canvas& canvas, const Diagram& diagram);
void drawCartesian(Canvas& canvas, const Diagram& diagram);
/// @}

/// @{
/// Of the first luminaire: width of the beam and illuminance over the distance, lines of equal illuminance on a plane
/// below, and the solid whose radii are the intensities.
void drawCone(Canvas& canvas, const Diagram& diagram);
void drawIsolux(Canvas& canvas, const Diagram& diagram);
void drawSolid(Canvas& canvas, const Diagram& diagram);
/// @}

/// Two curves without any text, to be shown small.
void drawThumbnail(Canvas& canvas, const Subject& subject);

}  // namespace OvPlot
