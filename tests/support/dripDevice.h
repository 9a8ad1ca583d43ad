#pragma once

#include <string>

#include "components/support/devices.h"

/// Memory that shows its bytes one at a time, so that no token lies wholly in its window.
class DripDevice : public Ov::RnMemoryBuffer {
public:
    explicit DripDevice(std::string bytes) : _input(std::move(bytes)) {}

protected:
    bool readMore() override {
        if (_shown == _input.size()) return false;
        append(&_input[_shown++], 1);
        return true;
    }

private:
    const std::string _input;
    std::size_t _shown = 0;
};
