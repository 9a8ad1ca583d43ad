#include "plot/solid.h"

#include "plot/curve.h"

namespace OvPlot {

namespace {

constexpr double steps = 720;  // in which the profile is followed
constexpr double shortestAxis = 0.55;
constexpr double overhang = 0.15;  // of an axis, beyond the solid

/// The largest intensity at a gamma, of planes 15 degrees apart.
double profileAt(const Subject& subject, double gamma) {
    double most = 0;
    for (double c = 0; c < 360; c += 15) most = std::max(most, double{subject.intensity(gamma, c)});
    return most;
}

/// Gammas that cut the profile's curve around the origin into pieces of one length.
std::vector<double> spacedGammas(const Subject& subject, std::size_t count) {
    std::vector<double> lengths{0};
    Path path;
    for (int i = 0; i <= steps; ++i) {
        const double gamma = 180 * i / steps;
        const double radius = profileAt(subject, gamma);
        path.push_back({radius * std::sin(radians(gamma)), radius * std::cos(radians(gamma))});
        if (i > 0) lengths.push_back(lengths.back() + distance(path[path.size() - 2], path.back()));
    }
    std::vector<double> gammas{0};
    std::size_t at = 0;
    for (std::size_t i = 1; i < count; ++i) {
        const double wanted = lengths.back() * static_cast<double>(i) / static_cast<double>(count);
        while (at + 1 < lengths.size() && lengths[at] < wanted) ++at;
        const double gamma = 180 * static_cast<double>(at) / steps;
        if (gamma > gammas.back()) gammas.push_back(gamma);
    }
    gammas.push_back(180);
    return gammas;
}

struct Space {
    double x = 0;  // towards C0
    double y = 0;  // towards C90
    double z = 0;  // upwards
};

Space spaceAt(double gamma, double c, double radius) {
    const double across = radius * std::sin(radians(gamma));
    return {across * std::cos(radians(c)), across * std::sin(radians(c)), -radius * std::cos(radians(gamma))};
}

/// An isometric view from above, C0 to the front right, C90 to the back right.
struct View {
    double turn = radians(-45);
    double tilt = std::atan(std::sqrt(0.5));

    Point onPaper(const Space& p) const {
        const double towards = p.x * std::cos(turn) + p.y * std::sin(turn);
        return {p.y * std::cos(turn) - p.x * std::sin(turn), std::sin(tilt) * towards - std::cos(tilt) * p.z};
    }
    double nearness(const Space& p) const {
        return std::cos(tilt) * (p.x * std::cos(turn) + p.y * std::sin(turn)) + std::sin(tilt) * p.z;
    }
};

/// What is drawn, farther pieces first, so that nearer ones hide them.
struct Piece {
    double nearness;
    std::vector<Space> corners;
    bool isAxis = false;
};

void addFaces(const SolidMesh& mesh, const View& view, std::vector<Piece>& pieces) {
    const double step = 360.0 / static_cast<double>(mesh.planes);
    for (std::size_t plane = 0; plane < mesh.planes; ++plane) {
        for (std::size_t i = 0; i + 1 < mesh.gammas.size(); ++i) {
            const double c = step * static_cast<double>(plane);
            Piece face{0,
                       {spaceAt(mesh.gammas[i], c, mesh.radius(plane, i)),
                        spaceAt(mesh.gammas[i], c + step, mesh.radius(plane + 1, i)),
                        spaceAt(mesh.gammas[i + 1], c + step, mesh.radius(plane + 1, i + 1)),
                        spaceAt(mesh.gammas[i + 1], c, mesh.radius(plane, i + 1))}};
            const Point a = view.onPaper(face.corners[2]) - view.onPaper(face.corners[0]);
            const Point b = view.onPaper(face.corners[3]) - view.onPaper(face.corners[1]);
            if (a.x * b.y - a.y * b.x > -1e-9) continue;  // seen from within, or no face
            for (const Space& corner : face.corners) face.nearness += view.nearness(corner) / 4;
            pieces.push_back(std::move(face));
        }
    }
}

struct AxisEnd {
    double gamma;
    double c;
    const char* name;
    const char* aimedName;
    double from = 0;  // where it leaves the solid

    double length() const { return std::max(shortestAxis, from + overhang); }
    Space end(double beyond = 0) const { return spaceAt(gamma, c, length() + beyond); }
};

/// The part of an axis outside the solid, in pieces that may be hidden.
void addAxis(const View& view, const AxisEnd& axis, std::vector<Piece>& pieces) {
    constexpr int parts = 24;
    for (int i = 0; i < parts; ++i) {
        const auto at = [&](int k) {
            return spaceAt(axis.gamma, axis.c, axis.from + (axis.length() - axis.from) * k / parts);
        };
        Piece part{0, {at(i), at(i + 1)}, true};
        part.nearness = view.nearness(at(i));
        pieces.push_back(std::move(part));
    }
}

/// Whether a face that is nearer hides a place.
bool isHidden(const std::vector<Piece>& pieces, const View& view, const Space& place) {
    const Point p = view.onPaper(place);
    const auto hides = [&](const Piece& piece) {
        if (piece.isAxis || piece.nearness <= view.nearness(place)) return false;
        bool inside = false;  // crossed by a line to the right an odd number of times
        for (std::size_t i = 0; i < piece.corners.size(); ++i) {
            const Point a = view.onPaper(piece.corners[i]);
            const Point b = view.onPaper(piece.corners[(i + 1) % piece.corners.size()]);
            if ((a.y > p.y) != (b.y > p.y) && p.x < a.x + (p.y - a.y) / (b.y - a.y) * (b.x - a.x))
                inside = !inside;
        }
        return inside;
    };
    return std::any_of(pieces.begin(), pieces.end(), hides);
}

/// How bright a face is that is lit from the upper left behind the viewer; 0 to 1.
double shade(const std::vector<Space>& q) {
    const Space a{q[2].x - q[0].x, q[2].y - q[0].y, q[2].z - q[0].z};
    const Space b{q[3].x - q[1].x, q[3].y - q[1].y, q[3].z - q[1].z};
    const Space n{a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
    const double length = std::sqrt(n.x * n.x + n.y * n.y + n.z * n.z);
    const double cosine = length > 0 ? (0.25 * n.x - 0.65 * n.y + 0.72 * n.z) / length : 0;
    return std::clamp(0.5 + 0.5 * cosine, 0.0, 1.0);
}

}  // namespace

SolidMesh solidMesh(const Subject& subject, std::size_t gammas, std::size_t planes) {
    SolidMesh mesh{spacedGammas(subject, gammas), planes, {}, 0};
    for (std::size_t plane = 0; plane < planes; ++plane) {
        for (const double gamma : mesh.gammas) {
            const double c = 360.0 * static_cast<double>(plane) / static_cast<double>(planes);
            mesh.radii.push_back(subject.intensity(gamma, c));
            mesh.peak = std::max(mesh.peak, mesh.radii.back());
        }
    }
    for (double& radius : mesh.radii) radius = mesh.peak > 0 ? radius / mesh.peak : 0;
    return mesh;
}

void drawSolid(Canvas& canvas, const Diagram& diagram) {
    const Subject& subject = diagram.subjects.front();
    const Box room = drawCaption(canvas, diagram, "Photometric solid: as far as it is bright", false);

    // The solid in pieces, and the axes, which start at its surface.
    const View view;
    const SolidMesh mesh = solidMesh(subject, 32, 30);
    std::vector<Piece> pieces;
    addFaces(mesh, view, pieces);

    AxisEnd ends[] = {{90, 0, "C0", "right"},
                      {90, 90, "C90", "up"},
                      {90, 180, "C180", "left"},
                      {90, 270, "C270", "down"},
                      {0, 0, "\u03b3 0\u00b0", "axis"}};
    Box box{0, 0, 0, 0};
    const auto include = [&](const Space& p) {
        const Point at = view.onPaper(p);
        box = {std::min(box.left, at.x), std::min(box.top, at.y), std::max(box.right, at.x),
               std::max(box.bottom, at.y)};
    };
    for (AxisEnd& end : ends) {
        end.from = mesh.peak > 0 ? subject.intensity(end.gamma, end.c) / mesh.peak : 0;
        addAxis(view, end, pieces);
        include(end.end());
    }
    for (const Piece& piece : pieces)
        for (const Space& corner : piece.corners) include(corner);

    // Scaled to the room.
    const double scale = std::min((room.width() - 60) / box.width(), (room.height() - 40) / box.height());
    const auto place = [&](const Space& p) { return room.centre() + scale * (view.onPaper(p) - box.centre()); };

    // The far pieces first, those behind hidden by those in front.
    std::stable_sort(pieces.begin(), pieces.end(),
                     [](const Piece& a, const Piece& b) { return a.nearness < b.nearness; });
    const Palette& palette = canvas.palette();
    for (const Piece& piece : pieces) {
        Path path;
        for (const Space& corner : piece.corners) path.push_back(place(corner));
        if (piece.isAxis) {
            canvas.stroke(path, false, {palette.muted, 1.2, 0});
            continue;
        }
        const double brightness = shade(piece.corners);
        const Colour base = palette.series[0];
        const Colour fill =
            brightness < 0.5 ? mixed({0, 0, 0}, base, 0.45 + 1.1 * brightness)
                             : mixed(base, {1, 1, 1}, 1.2 * (brightness - 0.5));
        canvas.face(path, fill, {mixed(fill, {0, 0, 0}, 0.25), 0.6, 0});
    }

    // Names of the axes that are in sight.
    for (const AxisEnd& end : ends)
        if (!isHidden(pieces, view, end.end()))
            canvas.label(place(end.end(0.06)), subject.frame.aimed ? end.aimedName : end.name, canvas.mutedFont());
}

}  // namespace OvPlot
