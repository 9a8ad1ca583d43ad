#pragma once

#include "plot/diagram.h"

namespace OvPlot {

/// The photometric solid: in each direction as far from the luminaire as it is bright there.
struct SolidMesh {
    std::vector<double> gammas;  // where the radii change most, nearest to each other
    std::size_t planes = 0;      // C 0, 360 / planes, ...
    std::vector<double> radii;   // plane after plane; the largest is 1, or all are 0
    double peak = 0;             // what 1 stands for

    double radius(std::size_t plane, std::size_t gamma) const {
        return radii[plane % planes * gammas.size() + gamma];
    }
};

SolidMesh solidMesh(const Subject& subject, std::size_t gammas, std::size_t planes);

}  // namespace OvPlot
