#include "tools/ovphoto/report/page.h"

#include <algorithm>
#include <cmath>

#include "components/support/path.h"
#include "plot/solid.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/fileAngles.h"
#include "tools/ovphoto/json.h"
#include "tools/ovphoto/report/html.h"
#include "tools/ovphoto/webTexts.h"
#include "tools/ovphoto/webWarnings.h"

namespace OvTool {

using OvPlot::Canvas;

namespace {

constexpr std::size_t mostRows = 2000;
constexpr std::size_t mostValues = 20000;  // in the tables of a page
constexpr std::size_t columnsEach = 12;    // of a candela table: as many as fit on A4

std::string drawn(const OvPlot::Diagram& diagram, void (*draw)(Canvas&, const OvPlot::Diagram&),
                  const char* what) {
    const std::string title = std::string(what) + ": " + diagram.title;
    const std::string svg = OvPlot::drawPicture(OvPlot::PictureFormat::svg, {}, OvPlot::lightPalette(), title,
                                                [&](Canvas& canvas) { draw(canvas, diagram); });
    return inlineSvg(svg, std::string(what, 4) + "-");
}

std::string figure(const OvPlot::Diagram& diagram, void (*draw)(Canvas&, const OvPlot::Diagram&),
                   const char* what) {
    return "<figure>" + drawn(diagram, draw, what) + "<figcaption>" + what + "</figcaption></figure>\n";
}

std::string keyFigures(const OvPlot::Subject& subject) {
    std::string list = "<dl class=\"key\">\n";
    for (const std::string& note : subject.notes) {
        const std::size_t blank = note.find(' ');
        list += "<div><dt>" + escaped(note.substr(0, blank)) + "</dt><dd>" + escaped(note.substr(blank + 1)) +
                "</dd></div>\n";
    }
    return list + "</dl>\n";
}

/// What the script turns: radii in thousandths, and where axes leave the solid.
std::string meshJson(const OvPlot::Subject& subject) {
    const OvPlot::SolidMesh mesh = OvPlot::solidMesh(subject, 32, 36);
    std::vector<int> radii;
    for (const double radius : mesh.radii) radii.push_back(static_cast<int>(std::lround(1000 * radius)));
    Json axes = Json::array();
    const auto addAxis = [&](const char* name, double gamma, double c) {
        const double from = mesh.peak > 0 ? subject.intensity(gamma, c) / mesh.peak : 0;
        axes.push_back({name, static_cast<float>(gamma), static_cast<float>(c), static_cast<float>(from)});
    };
    const bool aimed = subject.frame.aimed;
    addAxis(aimed ? "right" : "C0", 90, 0);
    addAxis(aimed ? "up" : "C90", 90, 90);
    addAxis(aimed ? "left" : "C180", 90, 180);
    addAxis(aimed ? "down" : "C270", 90, 270);
    addAxis(aimed ? "axis" : "\u03b3 0\u00b0", 0, 0);
    return Json{{"gammas", mesh.gammas}, {"planes", mesh.planes}, {"radii", radii}, {"axes", axes}}.dump();
}

std::string solidFigure(const OvPlot::Diagram& diagram) {
    return "<figure id=\"solid\">" + drawn(diagram, OvPlot::drawSolid, "Photometric solid") +
           "<figcaption>Photometric solid</figcaption></figure>\n<script type=\"application/json\" id=\"mesh\">" +
           meshJson(diagram.subjects.front()) + "</script>\n";
}

std::string anglesText(const std::optional<OvPlot::AngleSpan>& angle) {
    return angle ? fixedNumber(angle->width(), 1) : "\u2013";
}

std::string beamTable(const DrawnFile& file) {
    std::string table =
        "<table><caption>Beam angles in degrees</caption><thead><tr><th scope=\"col\">Plane</th>"
        "<th scope=\"col\">Beam, 50 %</th><th scope=\"col\">Field, 10 %</th></tr></thead><tbody>\n";
    for (const BeamAngles& angles : file.angles)
        table += std::string("<tr><th scope=\"row\">") + angles.plane + "</th><td>" + anglesText(angles.beam) +
                 "</td><td>" + anglesText(angles.field) + "</td></tr>\n";
    return table + "</tbody></table>\n";
}

std::string factsSection(const DrawnFile& file) {
    std::vector<std::pair<std::string, std::string>> facts;
    for (const Fact& fact : file.source.facts) facts.emplace_back(Ov::toUtf8(fact.key), Ov::toUtf8(fact.text));
    return "<section><h2>Facts</h2><div class=\"columns\">\n" +
           factTable("Light distribution", webTexts(file.source)) + beamTable(file) +
           (facts.empty() ? "" : factTable("In the file", facts)) + "</div></section>\n";
}

std::string checkSection(const std::vector<std::string>& remarks) {
    std::string section = "<section><h2>Check</h2>\n";
    if (remarks.empty()) return section + "<p>Nothing to report.</p></section>\n";
    section += "<ul>\n";
    for (const std::string& remark : remarks) section += "<li>" + escaped(remark) + "</li>\n";
    return section + "</ul></section>\n";
}

/// What a table of candela shows: its rows and columns by the angles of the file.
struct CandelaValues {
    Ov::RnPhotoWebData& web;
    std::vector<double> verticals;
    std::vector<double> horizontals;
    float peak;

    /// The plane that closes the circle, which the web does without, is the first.
    double candela(int j, int i) const { return double{web.getCandela(j < web.getPsiCount() ? j : 0, i)} * peak; }
};

/// Some of the planes.
std::string candelaTable(const CandelaValues& values, std::size_t first, std::size_t last) {
    std::string table = "<table class=\"candela\"><caption>cd, horizontal " +
                        shortNumber(values.horizontals[first]) +
                        (last > first ? " to " + shortNumber(values.horizontals[last]) : "") +
                        " deg</caption><thead><tr><th scope=\"col\">vertical \\ horizontal</th>";
    for (std::size_t j = first; j <= last; ++j)
        table += "<th scope=\"col\">" + shortNumber(values.horizontals[j]) + "</th>";
    table += "</tr></thead><tbody>\n";
    for (std::size_t i = 0; i < values.verticals.size(); ++i) {
        table += "<tr><th scope=\"row\">" + shortNumber(values.verticals[i]) + "</th>";
        for (std::size_t j = first; j <= last; ++j)
            table += "<td>" + shortNumber(values.candela(static_cast<int>(j), static_cast<int>(i))) + "</td>";
        table += "</tr>\n";
    }
    return table + "</tbody></table>\n";
}

std::string candelaSection(const DrawnFile& file) {
    Ov::RnPhotoWebData& web = *file.source.web;
    CandelaValues values{web, verticalsOf(web), horizontalsOf(web), file.light->getPeakIntensity()};
    const std::size_t rows = values.verticals.size(), columns = values.horizontals.size();
    values.verticals.resize(std::min(rows, mostRows));
    values.horizontals.resize(std::min(columns, std::max<std::size_t>(mostValues / values.verticals.size(), 1)));
    std::string section =
        "<section><h2 id=\"candela\">Luminous intensities</h2>\n"
        "<p class=\"muted\">At the angles of the file, degrees.</p>\n";
    if (values.verticals.size() < rows || values.horizontals.size() < columns)
        section += "<p>The first " + std::to_string(values.verticals.size()) + " of " + std::to_string(rows) +
                   " vertical and " + std::to_string(values.horizontals.size()) + " of " +
                   std::to_string(columns) +
                   " horizontal angles. All values: <code>ovphoto info --json --values</code></p>\n";
    section += "<div class=\"scroll\" role=\"region\" aria-labelledby=\"candela\" tabindex=\"0\">\n";
    for (std::size_t first = 0; first < values.horizontals.size(); first += columnsEach)
        section += candelaTable(values, first, std::min(first + columnsEach, values.horizontals.size()) - 1);
    return section + "</div></section>\n";
}

}  // namespace

Datasheet datasheetOf(DrawnFile file) {
    Datasheet sheet{std::move(file), {}, {}};
    sheet.remarks = sheet.file.source.told();
    const auto warnings = webWarnings(sheet.file.source);
    sheet.remarks.insert(sheet.remarks.end(), warnings.begin(), warnings.end());
    sheet.diagram = diagramOf({&sheet.file, 1});
    return sheet;
}

std::string datasheetPage(const Datasheet& sheet, const std::string& indexUrl) {
    const OvPlot::Diagram& diagram = sheet.diagram;
    std::string body;
    if (!indexUrl.empty()) body += "<p class=\"back\"><a href=\"" + indexUrl + "\">All files</a></p>\n";
    body += "<header><h1>" + escaped(diagram.title) + "</h1>\n<p class=\"muted\">" +
            escaped(sheet.file.source.file) + "</p></header>\n<main>\n" + keyFigures(diagram.subjects.front()) +
            "<section><h2>Diagrams</h2><div class=\"diagrams\">\n" +
            figure(diagram, OvPlot::drawPolar, "Polar diagram") +
            figure(diagram, OvPlot::drawCartesian, "Linear diagram") +
            figure(diagram, OvPlot::drawCone, "Cone diagram") +
            figure(diagram, OvPlot::drawIsolux, "Isolux lines") + solidFigure(diagram) + "</div></section>\n" +
            factsSection(sheet.file) + checkSection(sheet.remarks) + candelaSection(sheet.file) + "</main>\n";
    return htmlPage(diagram.title, body, pageScript);
}

std::string thumbnail(const Datasheet& sheet, const std::string& prefix) {
    const OvPlot::Subject& subject = sheet.diagram.subjects.front();
    return inlineSvg(
        OvPlot::drawPicture(OvPlot::PictureFormat::svg, {100, 100}, OvPlot::lightPalette(), "Polar diagram",
                            [&](Canvas& canvas) { OvPlot::drawThumbnail(canvas, subject); }),
        prefix);
}

}  // namespace OvTool
