#include "plot/caption.h"

namespace OvPlot {

namespace {

constexpr double margin = 24;
constexpr double rowHeight = 21;
constexpr double swatchWidth = 40;  // with the gap behind it
constexpr double gap = 22;
constexpr double titleRow = 23;
constexpr double subtitleRow = 18;

double widthOf(const Canvas& canvas, const LegendItem& item) {
    return (item.swatch ? swatchWidth : 0) + canvas.textWidth(item.text, canvas.font());
}

std::vector<std::vector<LegendItem>> rowsOf(const Canvas& canvas, const std::vector<LegendItem>& items) {
    std::vector<std::vector<LegendItem>> rows;
    double room = 0;
    for (const LegendItem& item : items) {
        const double width = widthOf(canvas, item);
        if (rows.empty() || item.startsRow || width > room) {
            rows.emplace_back();
            room = canvas.width() - 2 * margin;
        }
        rows.back().push_back(item);
        room -= width + gap;
    }
    return rows;
}

void drawRow(Canvas& canvas, double y, const std::vector<LegendItem>& row) {
    double x = margin;
    for (const LegendItem& item : row) {
        const double start = item.swatch ? x + swatchWidth : x;
        if (item.swatch) canvas.line({x, y}, {start - 6, y}, *item.swatch);
        canvas.text({start, y}, canvas.fitted(item.text, canvas.font(), canvas.width() - margin - start),
                    canvas.font());
        x += widthOf(canvas, item) + gap;
    }
}

}  // namespace

double legendRoom(const Canvas& canvas) { return canvas.width() - 2 * margin - swatchWidth; }

Box drawCaption(Canvas& canvas, const std::string& title, const std::string& subtitle,
                const std::vector<LegendItem>& legend) {
    const double room = canvas.width() - 2 * margin;
    const Font titleFont{17, canvas.palette().ink, true};
    const Font font = canvas.mutedFont();
    double y = 28;
    for (const std::string& line : canvas.wrapped(title, titleFont, room, 3)) {
        canvas.text({margin, y}, line, titleFont);
        y += titleRow;
    }
    for (const std::string& line : canvas.wrapped(subtitle, font, room, 2)) {
        canvas.text({margin, y}, line, font);
        y += subtitleRow;
    }
    const auto rows = rowsOf(canvas, legend);
    const double top = canvas.height() - 14 - rowHeight * static_cast<double>(rows.size());
    for (std::size_t i = 0; i < rows.size(); ++i)
        drawRow(canvas, top + rowHeight * (static_cast<double>(i) + 0.5), rows[i]);
    return {margin, y - 1, canvas.width() - margin, top - 8};
}

}  // namespace OvPlot
