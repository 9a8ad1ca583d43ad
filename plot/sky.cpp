#include "plot/axis.h"
#include "plot/skyDiagram.h"
#include "plot/skyDome.h"

namespace OvPlot {

namespace {

constexpr int pixelsAcross = 420;

/// Dark blue over green to yellow, evenly brighter: the scale "viridis" of Smith and van der Walt (2015).
Colour scaleColour(double share) {
    static constexpr Colour stops[] = {colour(0x440154), colour(0x46327e), colour(0x365c8d), colour(0x277f8e),
                                       colour(0x1fa187), colour(0x4ac16d), colour(0xa0da39), colour(0xfde725)};
    const double at = std::clamp(share, 0.0, 1.0) * (std::size(stops) - 1);
    const auto below = std::min(static_cast<std::size_t>(at), std::size(stops) - 2);
    return mixed(stops[below], stops[below + 1], at - static_cast<double>(below));
}

std::uint32_t pixelOf(Colour colour) {
    const auto byte = [](double value) { return static_cast<std::uint32_t>(std::lround(255 * value)); };
    return 0xff000000U | byte(colour.red) << 16 | byte(colour.green) << 8 | byte(colour.blue);
}

/// Luminances of square pixels around the zenith, negative below the horizon.
std::vector<float> luminances(Ov::RnNaturalLight& daylight) {
    std::vector<float> values;
    constexpr double half = (pixelsAcross - 1) / 2.0;
    for (int row = 0; row < pixelsAcross; ++row) {
        for (int column = 0; column < pixelsAcross; ++column) {
            const double east = (half - column) / half;  // on the left
            const double south = (row - half) / half;
            const double zenith = 90 * std::hypot(east, south);
            const double azimuth = degrees(std::atan2(-east, south));
            // A little beyond the horizon, which a line covers.
            values.push_back(zenith > 91 ? -1
                                         : daylight.getSkyLuminanceAt(static_cast<float>(std::min(zenith, 89.5)),
                                                                   static_cast<float>(azimuth)));
        }
    }
    return values;
}

void drawLuminances(Canvas& canvas, const SkyDome& dome, const std::vector<float>& values, const Axis& axis) {
    std::vector<std::uint32_t> pixels;
    for (const float value : values) pixels.push_back(value < 0 ? 0 : pixelOf(scaleColour(axis.share(value))));
    const Point corner{dome.radius, dome.radius};
    const Point first = dome.centre - corner;
    const Point last = dome.centre + corner;
    canvas.image({first.x, first.y, last.x, last.y}, pixelsAcross, pixels);
}

void drawScale(Canvas& canvas, const Box& box, const Axis& axis) {
    constexpr int steps = 64;
    const double step = box.height() / steps;
    for (int i = 0; i < steps; ++i) {
        const double bottom = box.bottom - i * step;
        canvas.rectangle({box.left, std::max(bottom - step - 1, box.top), box.right, bottom},
                         scaleColour((i + 0.5) / steps));
    }
    for (const double tick : axis.ticks()) {
        const double y = box.bottom - axis.share(tick) * box.height();
        canvas.line({box.right, y}, {box.right + 4, y}, {canvas.palette().ink, 1, 0});
        canvas.text({box.right + 8, y}, tickLabel(tick), canvas.font(12));
    }
    canvas.text({box.left, box.top - 18}, "cd/m\u00b2", canvas.font());
}

void drawDome(Canvas& canvas, const SkyDome& dome, const SkyWords& words) {
    const Palette& palette = canvas.palette();
    for (const double altitude : {30.0, 60.0}) {
        const Point place = dome.at(altitude, 180);
        canvas.circle(dome.centre, distance(place, dome.centre), {palette.paper, 0.8, 2});
        canvas.label(place, tickLabel(altitude) + "\u00b0", canvas.font(11));
    }
    canvas.circle(dome.centre, dome.radius, {palette.ink, 1.6, 0});
    for (const auto& [name, azimuth] : compassPoints(words.east))
        canvas.text(dome.outside(15, azimuth), name, {15, palette.ink, true}, Align::centre);
}

}  // namespace

void drawSky(Canvas& canvas, Ov::RnNaturalLight& daylight, const SkyCaption& caption) {
    // The dome, with room for a scale beside it.
    std::vector<LegendItem> legend;
    for (const std::string& note : caption.notes) legend.push_back({{}, note});
    const Box room = drawCaption(canvas, caption.title, caption.subtitle, legend);
    const double radius = std::min((room.width() - 110) / 2, room.height() / 2 - 26);
    const SkyDome dome{{room.left + (room.width() - 80) / 2, room.centre().y}, radius, true};

    // The sky's luminance, and the sun where it is up.
    const std::vector<float> values = luminances(daylight);
    const double most = *std::max_element(values.begin(), values.end());
    const Axis axis = axisTo(most, 6);
    drawLuminances(canvas, dome, values, axis);
    drawDome(canvas, dome, caption.words);
    const double altitude = degrees(daylight.getSolarAltitude());
    if (altitude > 0) {
        const Point sun = dome.at(altitude, degrees(daylight.getSolarAzimuth()));
        canvas.disc(sun, 9, colour(0x1a1a1a));
        canvas.disc(sun, 7, colour(0xffd23c));
    }

    // What the colours mean.
    if (most > 0) {
        drawScale(canvas,
                  {room.right - 62, dome.centre.y - radius * 0.8, room.right - 44, dome.centre.y + radius * 0.8},
                  axis);
    } else {
        canvas.label(dome.centre, caption.words.dark, canvas.font());
    }
}

}  // namespace OvPlot
