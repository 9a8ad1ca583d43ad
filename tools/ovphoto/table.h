#pragma once

#include <string>
#include <vector>

namespace OvTool {

/// Rows of texts, printed with their columns aligned.
class Table {
public:
    void add(std::vector<std::string> row);
    /// Prints the rows to standard output, each behind `indent` blanks.
    void print(std::size_t indent = 0) const;

private:
    std::vector<std::vector<std::string>> _rows;
};

}  // namespace OvTool
