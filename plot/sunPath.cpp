#include "plot/axis.h"
#include "plot/skyDiagram.h"
#include "plot/skyDome.h"

namespace OvPlot {

namespace {

constexpr int monthDay = 21;  // about the solstices and equinoxes
constexpr int hoursInDay = 24;
constexpr int daysInYear = 365;

struct SunPlace {
    double altitude;
    double azimuth;
};

SunPlace sunPlace(Ov::RnNaturalLight& daylight) {
    return {degrees(daylight.getSolarAltitude()), degrees(daylight.getSolarAzimuth())};
}

/// Where the line between two places crosses the horizon.
Point crossing(const SkyDome& dome, const SunPlace& a, const SunPlace& b) {
    const double share = a.altitude / (a.altitude - b.altitude);
    const Point from = dome.at(a.altitude, a.azimuth);
    return from + share * (dome.at(b.altitude, b.azimuth) - from);
}

/// The parts of a line that lie above the horizon.
std::vector<Path> aboveHorizon(const SkyDome& dome, const std::vector<SunPlace>& places) {
    std::vector<Path> paths;
    for (std::size_t i = 0; i < places.size(); ++i) {
        const bool up = places[i].altitude >= 0;
        const bool wasUp = i > 0 && places[i - 1].altitude >= 0;
        if (up && !wasUp) paths.emplace_back();
        if (i > 0 && up != wasUp) paths.back().push_back(crossing(dome, places[i - 1], places[i]));
        if (up) paths.back().push_back(dome.at(places[i].altitude, places[i].azimuth));
    }
    return paths;
}

/// The sun's way over the set day, from midnight to midnight by the sun.
std::vector<Path> dayPaths(const SkyDome& dome, Ov::RnNaturalLight& daylight) {
    std::vector<SunPlace> places;
    for (double hour = 0; hour <= hoursInDay; hour += 0.05) {
        daylight.setSolarTime(static_cast<float>(hour));
        places.push_back(sunPlace(daylight));
    }
    return aboveHorizon(dome, places);
}

/// Where it stands over the year when the clock shows an hour.
std::vector<SunPlace> hourPlaces(Ov::RnNaturalLight& daylight, int hour) {
    std::vector<SunPlace> places;
    for (int day = 1; day <= daysInYear; day += 4) {
        daylight.setDayOfYear(static_cast<std::uint16_t>(day));
        daylight.setLocalTime(static_cast<float>(hour));
        places.push_back(sunPlace(daylight));
    }
    places.push_back(places.front());
    return places;
}

void strokeAll(Canvas& canvas, const std::vector<Path>& paths, const Pen& pen) {
    for (const Path& path : paths) canvas.stroke(simplified(path, 0.04), false, pen);
}

/// The first of the places at which a text is free to stand.
bool placeText(Canvas& canvas, LabelPlacer& placer, const std::vector<std::pair<Point, Align>>& places,
               const std::string& text, const Font& font) {
    for (const auto& [place, align] : places) {
        if (!placer.take(canvas.textBox(place, text, font, align).grownBy(1))) continue;
        canvas.text(place, text, font, align);
        return true;
    }
    return false;
}

void drawDome(Canvas& canvas, const SkyDome& dome) {
    for (int altitude = 10; altitude < 90; altitude += 10)
        canvas.circle(dome.centre, distance(dome.at(altitude, 0), dome.centre), canvas.gridPen());
    for (int azimuth = 0; azimuth < 360; azimuth += 30)
        canvas.line(dome.centre, dome.at(0, azimuth), canvas.gridPen());
    canvas.circle(dome.centre, dome.radius, {canvas.palette().ink, 1.4, 0});
}

/// The letters of the compass, and bearings where there is room.
void drawCompass(Canvas& canvas, const SkyDome& dome, LabelPlacer& placer) {
    for (int azimuth = 0; azimuth < 360; azimuth += 30) {
        if (azimuth % 90 == 0) continue;
        placeText(canvas, placer, {{dome.outside(17, azimuth), Align::centre}},
                  std::to_string((azimuth + 180) % 360) + "\u00b0", canvas.mutedFont(12));
    }
    for (int altitude = 20; altitude < 90; altitude += 20)
        placeText(canvas, placer, {{dome.at(altitude, 180), Align::centre}}, std::to_string(altitude) + "\u00b0",
                  canvas.mutedFont(11));
}

/// Labels a day's way where the sun rises or, for later months, where it sets.
void labelDay(Canvas& canvas, const SkyDome& dome, LabelPlacer& placer, const std::vector<Path>& paths,
              const std::string& text, bool atSet) {
    if (paths.empty()) return;
    const auto beside = [&](const Point& end) {
        const Point away = (1 / std::max(distance(end, dome.centre), 1.0)) * (end - dome.centre);
        return std::pair(end + 7 * away, away.x < 0 ? Align::right : Align::left);
    };
    const auto rise = beside(paths.front().front());
    const auto set = beside(paths.back().back());
    placeText(canvas, placer, {atSet ? set : rise, atSet ? rise : set}, text, canvas.font(11));
}

/// Labels an hour's line beyond the end where the sun is highest.
void labelHour(Canvas& canvas, const SkyDome& dome, LabelPlacer& placer, const std::vector<SunPlace>& places,
               int hour) {
    const auto byAltitude = [](const SunPlace& a, const SunPlace& b) { return a.altitude < b.altitude; };
    const SunPlace high = *std::max_element(places.begin(), places.end(), byAltitude);
    const SunPlace low = *std::min_element(places.begin(), places.end(), byAltitude);
    if (high.altitude < 2) return;
    const Point top = dome.at(high.altitude, high.azimuth);
    const Point along = top - dome.at(low.altitude, low.azimuth);
    const Point away = (1 / std::max(distance(along, {}), 1.0)) * along;
    placeText(canvas, placer, {{top + 11 * away, Align::centre}, {top + 20 * away, Align::centre}},
              std::to_string(hour), canvas.font(12));
}

std::vector<LegendItem> legendOf(const SkyCaption& caption, const std::array<std::string, 12>& months,
                                 const Pen pens[4]) {
    const SkyWords& words = caption.words;
    const std::string day = std::to_string(monthDay) + words.dayEnd;
    std::vector<LegendItem> legend{{pens[0], day + months[0] + words.to + day + months[5]},
                                   {pens[1], day + months[6] + words.to + day + months[11]},
                                   {pens[2], words.hours},
                                   {pens[3], words.setDay}};
    for (std::size_t i = 0; i < caption.notes.size(); ++i) legend.push_back({{}, caption.notes[i], i == 0});
    return legend;
}

}  // namespace

void drawSunPath(Canvas& canvas, Ov::RnNaturalLight& daylight, const SkyCaption& caption,
                 const std::array<std::string, 12>& months) {
    const Palette& palette = canvas.palette();
    const Pen pens[4] = {{palette.series[0], 1.6, 0},
                         {palette.series[2], 1.6, 1},
                         {palette.muted, 0.9, 0},
                         {palette.series[1], 2.6, 0}};
    const Box room = drawCaption(canvas, caption.title, caption.subtitle, legendOf(caption, months, pens));
    const SkyDome dome{room.centre(), std::min(room.width() / 2 - 74, room.height() / 2 - 28), false};
    LabelPlacer placer({0, room.top - 4, canvas.width(), room.bottom + 6});
    drawDome(canvas, dome);
    for (const auto& [name, azimuth] : compassPoints(caption.words.east))
        placeText(canvas, placer,
                  {{dome.outside(azimuth == 90 || azimuth == -90 ? 62 : 15, azimuth), Align::centre}}, name,
                  {15, palette.ink, true});

    // The position that was set is that of one moment; the ways follow from the site.
    const SunPlace now = sunPlace(daylight);
    const Ov::RnRef<Ov::RnNaturalLight> moving = daylight.clone();
    moving->setOverrideSolarPosition(false);
    std::vector<std::vector<SunPlace>> hours;
    for (int hour = 0; hour < hoursInDay; ++hour) {
        hours.push_back(hourPlaces(*moving, hour));
        strokeAll(canvas, aboveHorizon(dome, hours.back()), pens[2]);
    }
    for (int month = 1; month <= 12; ++month) {
        moving->setDate(month, monthDay);
        const std::vector<Path> paths = dayPaths(dome, *moving);
        strokeAll(canvas, paths, pens[month > 6]);
        labelDay(canvas, dome, placer, paths,
                 std::to_string(monthDay) + caption.words.dayEnd + months[static_cast<std::size_t>(month - 1)],
                 month > 6);
    }
    moving->setDayOfYear(daylight.getDayOfYear());
    strokeAll(canvas, dayPaths(dome, *moving), pens[3]);
    if (now.altitude > 0) {
        const Point sun = dome.at(now.altitude, now.azimuth);
        canvas.disc(sun, 9, palette.ink);
        canvas.disc(sun, 7, colour(0xffd23c));
        placer.block({sun.x - 10, sun.y - 10, sun.x + 10, sun.y + 10});
    }
    for (int hour = 0; hour < hoursInDay; ++hour)
        labelHour(canvas, dome, placer, hours[static_cast<std::size_t>(hour)], hour);
    drawCompass(canvas, dome, placer);
}

}  // namespace OvPlot
