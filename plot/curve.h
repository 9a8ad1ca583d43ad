#pragma once

#include "plot/caption.h"
#include "plot/diagram.h"

namespace OvPlot {

/// The intensities of a luminaire in a plane: towards C for positive angles from the axis, towards C + 180 for
/// negative ones, from -180 to 180 degrees in even steps.
class PlaneCurve {
public:
    PlaneCurve(const Subject& subject, double c, double step = 0.25);

    std::size_t size() const { return _values.size(); }
    double angle(std::size_t i) const { return static_cast<double>(i) * _step - 180; }
    double value(std::size_t i) const { return _values[i]; }
    /// The largest value at angles from the axis of `first` to `last` on either side.
    double largest(double first = 0, double last = 180) const;

private:
    double _step;
    std::vector<double> _values;
};

/// The curve around the origin: gamma 0 downwards, C to the right, at `scale` a candela. Closed.
Path polarPath(const PlaneCurve& curve, double scale);

/// "C0-C180", or what the plane of an aimed luminaire is called.
std::string planeName(const Subject& subject, double c);

/// The caption of a diagram, with its planes where `planes`; the room that is left.
Box drawCaption(Canvas& canvas, const Diagram& diagram, const std::string& subtitle, bool planes);

/// The pen of a plane of a subject: colours tell luminaires apart or, for a single one, planes; dashes planes.
Pen curvePen(const Canvas& canvas, const Diagram& diagram, std::size_t subject, std::size_t plane);

/// Every curve of a diagram: those of a subject beside each other.
std::vector<PlaneCurve> planeCurves(const Diagram& diagram);

}  // namespace OvPlot
