#include "tools/ovphoto/progress.h"

#include <iostream>

#include "tools/ovphoto/platform.h"

namespace OvTool {

Progress::Progress(std::size_t total) : _total(total), _shown(standardErrorIsTerminal()) {}

void Progress::next() {
    ++_done;
    if (_shown) std::cerr << "\r" << _done << " of " << _total << std::flush;
}

void Progress::clear() const {
    if (_shown) std::cerr << "\r\x1b[K" << std::flush;
}

}  // namespace OvTool
