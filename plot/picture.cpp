#include "plot/picture.h"

#include <cairo-pdf.h>
#include <cairo-svg.h>
#include <cairo.h>

#include <memory>
#include <stdexcept>

namespace OvPlot {

namespace {

constexpr double shorterSide = 600;  // of what is drawn on
constexpr double pointsPerPixel = 0.75;

using Surface = std::unique_ptr<cairo_surface_t, decltype(&cairo_surface_destroy)>;
using Context = std::unique_ptr<cairo_t, decltype(&cairo_destroy)>;

cairo_status_t append(void* bytes, const unsigned char* data, unsigned length) try {
    static_cast<std::string*>(bytes)->append(reinterpret_cast<const char*>(data), length);
    return CAIRO_STATUS_SUCCESS;
} catch (...) {
    return CAIRO_STATUS_NO_MEMORY;
}

void require(cairo_status_t status) {
    if (status != CAIRO_STATUS_SUCCESS)
        throw std::runtime_error(std::string("cannot be drawn: ") + cairo_status_to_string(status));
}

cairo_surface_t* newSurface(PictureFormat format, PictureSize size, std::string& bytes) {
    switch (format) {
        case PictureFormat::svg: {
            cairo_surface_t* surface =
                cairo_svg_surface_create_for_stream(append, &bytes, size.width, size.height);
            cairo_svg_surface_set_document_unit(surface, CAIRO_SVG_UNIT_PX);
            return surface;
        }
        case PictureFormat::pdf:
            return cairo_pdf_surface_create_for_stream(append, &bytes, size.width * pointsPerPixel,
                                                       size.height * pointsPerPixel);
        case PictureFormat::png:
            break;
    }
    return cairo_image_surface_create(CAIRO_FORMAT_RGB24, size.width, size.height);
}

void drawOn(cairo_surface_t* surface, double scale, PictureSize size, const Palette& palette,
            const std::function<void(Canvas&)>& draw) {
    const Context cairo(cairo_create(surface), cairo_destroy);
    const double unit = std::min(size.width, size.height) / shorterSide;
    cairo_scale(cairo.get(), scale * unit, scale * unit);
    Canvas canvas(cairo.get(), size.width / unit, size.height / unit, palette);
    draw(canvas);
    require(cairo_status(cairo.get()));
}

/// Cairo writes no title; readers of the screen want one.
void insertTitle(std::string& svg, const std::string& title) {
    const std::size_t root = svg.find("<svg");
    const std::size_t end = root == std::string::npos ? root : svg.find('>', root);
    if (end != std::string::npos) svg.insert(end + 1, "\n<title>" + escaped(title) + "</title>");
}

}  // namespace

std::string drawPicture(PictureFormat format, PictureSize size, const Palette& palette, const std::string& title,
                        const std::function<void(Canvas&)>& draw) {
    std::string bytes;
    const Surface surface(newSurface(format, size, bytes), cairo_surface_destroy);
    require(cairo_surface_status(surface.get()));
    if (format == PictureFormat::pdf)
        cairo_pdf_surface_set_metadata(surface.get(), CAIRO_PDF_METADATA_TITLE, cleanText(title).c_str());
    drawOn(surface.get(), format == PictureFormat::pdf ? pointsPerPixel : 1, size, palette, draw);
    if (format == PictureFormat::png) require(cairo_surface_write_to_png_stream(surface.get(), append, &bytes));
    cairo_surface_finish(surface.get());
    require(cairo_surface_status(surface.get()));
    if (format == PictureFormat::svg) insertTitle(bytes, title);
    return bytes;
}

std::string escaped(std::string_view text) {
    // Every character that means something in markup, within quotes of either kind, too.
    std::string result;
    for (const char c : cleanText(text)) {
        switch (c) {
            case '&':
                result += "&amp;";
                break;
            case '<':
                result += "&lt;";
                break;
            case '>':
                result += "&gt;";
                break;
            case '"':
                result += "&quot;";
                break;
            case '\'':
                result += "&#39;";
                break;
            default:
                result += c;
        }
    }
    return result;
}

}  // namespace OvPlot
