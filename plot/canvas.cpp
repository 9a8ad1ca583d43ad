#include "plot/canvas.h"

#include <cairo.h>

#include <cstring>
#include <memory>
#include <numbers>

#include "components/support/path.h"

namespace OvPlot {

namespace {

constexpr double capitalShare = 0.73;  // of the font size, as in most sans-serif fonts
constexpr Palette lightColours{colour(0xffffff),
                               colour(0x1a1a1a),
                               colour(0x565656),
                               colour(0xcfcfcf),
                               {colour(0x0072b2), colour(0xd55e00), colour(0x009e73), colour(0xcc79a7),
                                colour(0xe69f00), colour(0x56b4e9), colour(0x1a1a1a), colour(0x8c6d1f)}};
constexpr Palette darkColours{colour(0x15171a),
                              colour(0xf2f2f2),
                              colour(0xb4b8be),
                              colour(0x464b52),
                              {colour(0x56b4e9), colour(0xff8a3d), colour(0x2cc59a), colour(0xe79fc6),
                               colour(0xf0c040), colour(0x9ab8ff), colour(0xf2f2f2), colour(0xf0e442)}};

std::vector<double> dashes(Dash dash) {
    static const std::vector<double> patterns[] = {{}, {8, 5}, {2, 4}, {10, 4, 2, 4}};
    return patterns[dash % std::size(patterns)];
}

}  // namespace

Colour mixed(Colour a, Colour b, double share) {
    const auto mix = [share](double x, double y) { return x + share * (y - x); };
    return {mix(a.red, b.red), mix(a.green, b.green), mix(a.blue, b.blue)};
}

const Palette& lightPalette() { return lightColours; }
const Palette& darkPalette() { return darkColours; }

Canvas::Canvas(cairo_t* cairo, double width, double height, const Palette& palette)
    : _cairo(cairo), _width(width), _height(height), _palette(palette) {
    // The same layout in every format.
    const std::unique_ptr<cairo_font_options_t, decltype(&cairo_font_options_destroy)> options(
        cairo_font_options_create(), cairo_font_options_destroy);
    cairo_font_options_set_hint_style(options.get(), CAIRO_HINT_STYLE_NONE);
    cairo_font_options_set_hint_metrics(options.get(), CAIRO_HINT_METRICS_OFF);
    cairo_font_options_set_antialias(options.get(), CAIRO_ANTIALIAS_GRAY);
    cairo_set_font_options(_cairo, options.get());
    cairo_set_line_join(_cairo, CAIRO_LINE_JOIN_ROUND);
    rectangle({0, 0, width, height}, palette.paper);
}

void Canvas::use(Colour colour) { cairo_set_source_rgb(_cairo, colour.red, colour.green, colour.blue); }

void Canvas::use(const Pen& pen) {
    use(pen.colour);
    cairo_set_line_width(_cairo, pen.width);
    const std::vector<double> pattern = dashes(pen.dash);
    cairo_set_dash(_cairo, pattern.data(), static_cast<int>(pattern.size()), 0);
}

void Canvas::line(Point from, Point to, const Pen& pen) { stroke({from, to}, false, pen); }

void Canvas::circle(Point centre, double radius, const Pen& pen) {
    arc(centre, radius, 0, 2 * std::numbers::pi, pen);
}

void Canvas::arc(Point centre, double radius, double from, double to, const Pen& pen) {
    cairo_new_path(_cairo);
    cairo_arc(_cairo, centre.x, centre.y, radius, from, to);
    use(pen);
    cairo_stroke(_cairo);
}

void Canvas::disc(Point centre, double radius, Colour fill) {
    cairo_new_path(_cairo);
    cairo_arc(_cairo, centre.x, centre.y, radius, 0, 2 * std::numbers::pi);
    use(fill);
    cairo_fill(_cairo);
}

void Canvas::trace(const Path& path, bool closed) {
    cairo_new_path(_cairo);
    for (const Point& point : path) cairo_line_to(_cairo, point.x, point.y);
    if (closed) cairo_close_path(_cairo);
}

void Canvas::stroke(const Path& path, bool closed, const Pen& pen) {
    trace(path, closed);
    use(pen);
    cairo_stroke(_cairo);
}

void Canvas::fill(const Path& path, Colour fill) {
    trace(path, true);
    use(fill);
    cairo_fill(_cairo);
}

void Canvas::face(const Path& path, Colour fill, const Pen& rim) {
    trace(path, true);
    use(fill);
    cairo_fill_preserve(_cairo);
    use(rim);
    cairo_stroke(_cairo);
}

void Canvas::rectangle(const Box& box, Colour fill) {
    cairo_rectangle(_cairo, box.left, box.top, box.width(), box.height());
    use(fill);
    cairo_fill(_cairo);
}

void Canvas::image(const Box& box, int side, const std::vector<std::uint32_t>& pixels) {
    const std::unique_ptr<cairo_surface_t, decltype(&cairo_surface_destroy)> surface(
        cairo_image_surface_create(CAIRO_FORMAT_ARGB32, side, side), cairo_surface_destroy);
    unsigned char* const bytes = cairo_image_surface_get_data(surface.get());
    if (!bytes) return;  // the canvas is told of a failed surface where it is used
    const auto stride = static_cast<std::size_t>(cairo_image_surface_get_stride(surface.get()));
    const auto rows = static_cast<std::size_t>(side);
    for (std::size_t row = 0; row < rows; ++row)
        std::memcpy(bytes + row * stride, &pixels[row * rows], rows * sizeof pixels[0]);
    cairo_surface_mark_dirty(surface.get());
    cairo_save(_cairo);
    cairo_translate(_cairo, box.left, box.top);
    cairo_scale(_cairo, box.width() / side, box.height() / side);
    cairo_set_source_surface(_cairo, surface.get(), 0, 0);
    cairo_paint(_cairo);
    cairo_restore(_cairo);
}

void Canvas::clipped(const Box& box, const std::function<void()>& draw) {
    cairo_save(_cairo);
    cairo_rectangle(_cairo, box.left, box.top, box.width(), box.height());
    cairo_clip(_cairo);
    draw();
    cairo_restore(_cairo);
}

void Canvas::select(const Font& font) const {
    cairo_select_font_face(_cairo, "sans-serif", CAIRO_FONT_SLANT_NORMAL,
                           font.bold ? CAIRO_FONT_WEIGHT_BOLD : CAIRO_FONT_WEIGHT_NORMAL);
    cairo_set_font_size(_cairo, font.size);
}

double Canvas::textWidth(std::string_view text, const Font& font) const {
    select(font);
    cairo_text_extents_t extents;
    cairo_text_extents(_cairo, cleanText(text).c_str(), &extents);
    return extents.x_advance;
}

Box Canvas::textBox(Point middle, std::string_view text, const Font& font, Align align) const {
    const double width = textWidth(text, font);
    const double left = middle.x - (align == Align::left ? 0 : align == Align::centre ? width / 2 : width);
    return {left, middle.y - font.size / 2, left + width, middle.y + font.size / 2};
}

void Canvas::text(Point middle, std::string_view text, const Font& font, Align align) {
    const Box box = textBox(middle, text, font, align);
    use(font.colour);
    cairo_move_to(_cairo, box.left, middle.y + font.size * capitalShare / 2);
    cairo_show_text(_cairo, cleanText(text).c_str());
}

void Canvas::textUpwards(Point middle, std::string_view text, const Font& font) {
    cairo_save(_cairo);
    cairo_translate(_cairo, middle.x, middle.y);
    cairo_rotate(_cairo, -std::numbers::pi / 2);
    this->text({0, 0}, text, font, Align::centre);
    cairo_restore(_cairo);
}

void Canvas::label(Point middle, std::string_view text, const Font& font) {
    rectangle(textBox(middle, text, font, Align::centre).grownBy(1), _palette.paper);
    this->text(middle, text, font, Align::centre);
}

std::string Canvas::fitted(std::string_view text, const Font& font, double width) const {
    if (textWidth(text, font) <= width) return std::string(text);
    std::wstring shorter = Ov::fromUtf8(cleanText(text));
    std::string result;
    do {
        shorter.pop_back();
        result = Ov::toUtf8(shorter) + "\u2026";
    } while (!shorter.empty() && textWidth(result, font) > width);
    return result;
}

std::vector<std::string> Canvas::wrapped(std::string_view text, const Font& font, double width,
                                         std::size_t most) const {
    std::vector<std::string> lines;
    std::wstring rest = Ov::fromUtf8(cleanText(text));
    const auto fits = [&](std::size_t count) {
        return textWidth(Ov::toUtf8(rest.substr(0, count)), font) <= width;
    };
    while (lines.size() + 1 < most && !fits(rest.size())) {
        std::size_t count = 1;
        while (fits(count + 1)) ++count;
        const std::size_t blank = rest.rfind(L' ', count);
        if (blank != std::wstring::npos && blank > 0) count = blank;
        lines.push_back(Ov::toUtf8(rest.substr(0, count)));
        rest.erase(0, std::min(rest.find_first_not_of(L' ', count), rest.size()));
    }
    lines.push_back(fitted(Ov::toUtf8(rest), font, width));
    return lines;
}

std::string cleanText(std::string_view text) {
    std::wstring clean = Ov::fromUtf8(text);
    for (wchar_t& c : clean) {
        const auto code = static_cast<std::uint32_t>(c);
        if (code < 0x20 || (code >= 0x7f && code < 0xa0)) c = L' ';
        if ((code >= 0xd800 && code < 0xe000) || (code & 0xfffe) == 0xfffe) c = L'\ufffd';
    }
    return Ov::toUtf8(clean);
}

bool LabelPlacer::take(const Box& box) {
    if (!_area.contains(box)) return false;
    if (std::any_of(_taken.begin(), _taken.end(), [&](const Box& other) { return other.overlaps(box); }))
        return false;
    _taken.push_back(box);
    return true;
}

}  // namespace OvPlot
