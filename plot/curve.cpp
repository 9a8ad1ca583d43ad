#include "plot/curve.h"

#include "plot/axis.h"

namespace OvPlot {

PlaneCurve::PlaneCurve(const Subject& subject, double c, double step) : _step(step) {
    const auto count = static_cast<std::size_t>(std::lround(360 / step)) + 1;
    for (std::size_t i = 0; i < count; ++i) {
        const double from = angle(i);
        _values.push_back(subject.intensity(std::abs(from), from < 0 ? c + 180 : c));
    }
}

double PlaneCurve::largest(double first, double last) const {
    double most = 0;
    for (std::size_t i = 0; i < size(); ++i) {
        const double gamma = std::abs(angle(i));
        if (gamma >= first && gamma <= last) most = std::max(most, value(i));
    }
    return most;
}

Path polarPath(const PlaneCurve& curve, double scale) {
    Path path;
    for (std::size_t i = 0; i + 1 < curve.size(); ++i) {
        const double radius = curve.value(i) * scale;
        path.push_back({radius * std::sin(radians(curve.angle(i))), radius * std::cos(radians(curve.angle(i)))});
    }
    path.push_back(path.front());
    return path;
}

std::string planeName(const Subject& subject, double c) {
    if (subject.frame.aimed && (c == 0 || c == 180)) return "horizontal";
    if (subject.frame.aimed && (c == 90 || c == 270)) return "vertical";
    const double opposite = c < 180 ? c + 180 : c - 180;
    return "C" + tickLabel(c) + "\u2013C" + tickLabel(opposite);
}

Pen curvePen(const Canvas& canvas, const Diagram& diagram, std::size_t subject, std::size_t plane) {
    const auto& series = canvas.palette().series;
    const std::size_t which = diagram.subjects.size() > 1 ? subject : plane;
    return {series[which % series.size()], 2, plane};
}

std::vector<PlaneCurve> planeCurves(const Diagram& diagram) {
    std::vector<PlaneCurve> curves;
    for (const Subject& subject : diagram.subjects)
        for (const double c : diagram.planes) curves.emplace_back(subject, c);
    return curves;
}

namespace {

/// A luminaire among others: its name and as many of its notes as there is room for, two at least; else the name is cut.
std::string legendText(const Canvas& canvas, const Subject& subject) {
    const double room = legendRoom(canvas);
    for (std::size_t count = subject.notes.size();; --count) {
        std::string notes;
        for (std::size_t i = 0; i < count; ++i) notes += (i == 0 ? ": " : ", ") + subject.notes[i];
        const double left = room - canvas.textWidth(notes, canvas.font());
        if (count <= 2 || canvas.textWidth(subject.name, canvas.font()) <= left)
            return canvas.fitted(subject.name, canvas.font(), std::max(room / 3, left)) + notes;
    }
}

std::vector<LegendItem> legendOf(const Canvas& canvas, const Diagram& diagram, bool planes) {
    std::vector<LegendItem> items;
    const bool several = diagram.subjects.size() > 1;
    for (std::size_t i = 0; planes && i < diagram.planes.size(); ++i) {
        Pen pen = curvePen(canvas, diagram, 0, i);
        if (several) pen.colour = canvas.palette().ink;
        items.push_back({pen, planeName(diagram.subjects.front(), diagram.planes[i])});
    }
    if (several) {
        for (std::size_t i = 0; i < diagram.subjects.size(); ++i)
            items.push_back({curvePen(canvas, diagram, i, 0), legendText(canvas, diagram.subjects[i]), true});
    } else {
        for (const std::string& note : diagram.subjects.front().notes)
            items.push_back({{}, note, &note == &diagram.subjects.front().notes.front()});
    }
    return items;
}

}  // namespace

Box drawCaption(Canvas& canvas, const Diagram& diagram, const std::string& subtitle, bool planes) {
    const bool aimed = diagram.subjects.front().frame.aimed;
    return drawCaption(canvas, diagram.title, subtitle + (aimed ? "; photometric axis down" : ""),
                       legendOf(canvas, diagram, planes));
}

}  // namespace OvPlot
