#include "plot/isolines.h"

#include <array>

namespace OvPlot {

namespace {

constexpr std::size_t none = static_cast<std::size_t>(-1);

/// Marching squares: every square between four values joins the points at which the level crosses its edges, and
/// the joined edges are followed to lines.
class Tracer {
public:
    Tracer(const Grid& grid, double level)
        : _grid(grid), _level(level), _links(2 * grid.values.size(), {none, none}) {
        for (std::size_t row = 0; row + 1 < grid.rows; ++row)
            for (std::size_t column = 0; column + 1 < grid.columns; ++column) joinIn(column, row);
    }

    std::vector<Path> lines() {
        std::vector<Path> found;
        for (const bool open : {true, false}) {
            for (std::size_t edge = 0; edge < _links.size(); ++edge) {
                const bool ends = _links[edge][1] == none;
                if (_links[edge][0] != none && ends == open) found.push_back(follow(edge));
            }
        }
        return found;
    }

private:
    // An edge is numbered by its upper left end: twice its place, plus 1 where it goes downwards.
    std::size_t across(std::size_t column, std::size_t row) const { return 2 * (row * _grid.columns + column); }
    std::size_t down(std::size_t column, std::size_t row) const { return across(column, row) + 1; }

    void join(std::size_t a, std::size_t b) {
        for (const auto& [from, to] : {std::pair{a, b}, {b, a}})
            _links[from][_links[from][0] == none ? 0 : 1] = to;
    }

    void joinIn(std::size_t column, std::size_t row) {
        const std::array<double, 4> corners{_grid.at(column, row), _grid.at(column + 1, row),
                                            _grid.at(column + 1, row + 1), _grid.at(column, row + 1)};
        const std::array<std::size_t, 4> edges{across(column, row), down(column + 1, row), across(column, row + 1),
                                               down(column, row)};
        std::array<std::size_t, 4> crossed{};
        std::size_t count = 0;
        for (std::size_t i = 0; i < 4; ++i)
            if ((corners[i] >= _level) != (corners[(i + 1) % 4] >= _level)) crossed[count++] = edges[i];
        if (count == 2) join(crossed[0], crossed[1]);
        if (count < 4) return;
        // A saddle: what the middle joins with is not cut off.
        const bool middle = (corners[0] + corners[1] + corners[2] + corners[3]) / 4 >= _level;
        const std::size_t shift = middle == (corners[0] >= _level) ? 0 : 1;
        join(crossed[shift], crossed[1 + shift]);
        join(crossed[2 + shift], crossed[(3 + shift) % 4]);
    }

    Point crossing(std::size_t edge) const {
        const std::size_t place = edge / 2;
        const std::size_t next = place + (edge % 2 ? _grid.columns : 1);
        const double share = (_level - _grid.values[place]) / (_grid.values[next] - _grid.values[place]);
        const Point start{static_cast<double>(place % _grid.columns), static_cast<double>(place / _grid.columns)};
        return start + (edge % 2 ? Point{0, share} : Point{share, 0});
    }

    /// Follows a line from an edge and forgets it.
    Path follow(std::size_t edge) {
        Path path;
        const std::size_t start = edge;
        for (std::size_t previous = none; edge != none;) {
            path.push_back(crossing(edge));
            const auto [a, b] = _links[edge];
            const std::size_t next = a == previous && previous != none ? b : a;
            if (edge != start) _links[edge] = {none, none};
            previous = edge;
            edge = next;
            if (edge == start) {
                path.push_back(path.front());
                break;
            }
        }
        _links[start] = {none, none};
        return path;
    }

    const Grid& _grid;
    double _level;
    std::vector<std::array<std::size_t, 2>> _links;
};

}  // namespace

std::vector<Path> isolines(const Grid& grid, double level) { return Tracer(grid, level).lines(); }

}  // namespace OvPlot
