#pragma once

#include <array>
#include <functional>
#include <string>
#include <string_view>

#include "plot/geometry.h"

// What pictures are drawn on. One unit is a pixel of a picture whose shorter side has 600; larger and smaller ones
// are scaled. Cairo draws, and stays behind this header.

typedef struct _cairo cairo_t;

namespace OvPlot {

struct Colour {
    double red = 0;
    double green = 0;
    double blue = 0;
};

constexpr Colour colour(unsigned rgb) {
    return {((rgb >> 16) & 255) / 255.0, ((rgb >> 8) & 255) / 255.0, (rgb & 255) / 255.0};
}
/// `share` of the second in the first.
Colour mixed(Colour a, Colour b, double share);

struct Palette {
    Colour paper;
    Colour ink;
    Colour muted;  // of texts that step back
    Colour grid;
    std::array<Colour, 8> series;  // told apart by colour-blind people: Okabe and Ito (2008)
};
const Palette& lightPalette();
const Palette& darkPalette();

/// Numbers a dash pattern; 0 is a solid line.
using Dash = std::size_t;

struct Pen {
    Colour colour;
    double width = 1;
    Dash dash = 0;
};

enum class Align { left, centre, right };

struct Font {
    double size = 13;
    Colour colour;
    bool bold = false;
};

class Canvas {
public:
    Canvas(cairo_t* cairo, double width, double height, const Palette& palette);

    double width() const { return _width; }
    double height() const { return _height; }
    const Palette& palette() const { return _palette; }
    Font font(double size = 13) const { return {size, _palette.ink, false}; }
    Font mutedFont(double size = 13) const { return {size, _palette.muted, false}; }
    Pen gridPen() const { return {_palette.grid, 1, 0}; }

    void line(Point from, Point to, const Pen& pen);
    void circle(Point centre, double radius, const Pen& pen);
    /// Part of a circle, between angles from the x axis towards the y axis.
    void arc(Point centre, double radius, double from, double to, const Pen& pen);
    void disc(Point centre, double radius, Colour fill);
    void stroke(const Path& path, bool closed, const Pen& pen);
    void fill(const Path& path, Colour fill);
    /// Filled, and its rim drawn.
    void face(const Path& path, Colour fill, const Pen& rim);
    void rectangle(const Box& box, Colour fill);
    /// Square pixels that fill the box, row after row, 0xAARRGGBB with the colours multiplied by alpha.
    void image(const Box& box, int side, const std::vector<std::uint32_t>& pixels);
    /// Nothing is drawn outside the box while `draw` runs.
    void clipped(const Box& box, const std::function<void()>& draw);

    /// A line of text; `middle` lies at half the height of its capitals.
    void text(Point middle, std::string_view text, const Font& font, Align align = Align::left);
    /// The same upwards.
    void textUpwards(Point middle, std::string_view text, const Font& font);
    /// Centred, on a patch of paper that hides what lies below.
    void label(Point middle, std::string_view text, const Font& font);
    /// What a text takes.
    Box textBox(Point middle, std::string_view text, const Font& font, Align align = Align::left) const;
    double textWidth(std::string_view text, const Font& font) const;
    /// The text, cut and ended by an ellipsis where it is wider.
    std::string fitted(std::string_view text, const Font& font, double width) const;
    /// The text in lines that are no wider, broken at blanks where there are some; the last of `most` is cut.
    std::vector<std::string> wrapped(std::string_view text, const Font& font, double width,
                                     std::size_t most) const;

private:
    void select(const Font& font) const;
    void trace(const Path& path, bool closed);
    void use(const Pen& pen);
    void use(Colour colour);

    cairo_t* _cairo;
    double _width;
    double _height;
    const Palette& _palette;
};

/// Text as it can be drawn: UTF-8 in one line; other bytes become U+FFFD, control characters blanks.
std::string cleanText(std::string_view text);

/// Keeps labels apart.
class LabelPlacer {
public:
    explicit LabelPlacer(const Box& area) : _area(area) {}
    /// Takes the place if it lies inside the area and is free.
    bool take(const Box& box);
    /// Lets nothing else stand there.
    void block(const Box& box) { _taken.push_back(box); }

private:
    Box _area;
    std::vector<Box> _taken;
};

}  // namespace OvPlot
