#include "tools/ovphoto/table.h"

#include <algorithm>

#include "tools/numbers/numbers.h"
#include "tools/ovphoto/terminal.h"

namespace OvTool {

void Table::add(std::vector<std::string> row) {
    for (std::string& text : row) text = printable(text);
    _rows.push_back(std::move(row));
}

void Table::print(std::size_t indent) const {
    std::vector<std::size_t> widths;
    for (const auto& row : _rows) {
        widths.resize(std::max(widths.size(), row.size()));
        for (std::size_t i = 0; i < row.size(); ++i) widths[i] = std::max(widths[i], characterCount(row[i]));
    }
    for (const auto& row : _rows) {
        std::string line(indent, ' ');
        for (std::size_t i = 0; i < row.size(); ++i) {
            line += row[i];
            if (i + 1 < row.size()) line.append(widths[i] - characterCount(row[i]) + 2, ' ');
        }
        say(line);
    }
}

}  // namespace OvTool
