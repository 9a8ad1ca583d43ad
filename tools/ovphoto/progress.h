#pragma once

#include <cstddef>

namespace OvTool {

/// A line on the terminal that tells how far the work is; nothing when standard error is no terminal.
class Progress {
public:
    explicit Progress(std::size_t total);
    ~Progress() { clear(); }
    Progress(const Progress&) = delete;
    Progress& operator=(const Progress&) = delete;

    void next();
    /// Makes room for other output.
    void clear() const;

private:
    std::size_t _total;
    std::size_t _done = 0;
    bool _shown;
};

}  // namespace OvTool
