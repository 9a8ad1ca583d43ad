#include "tools/ovphoto/standardStreams.h"

#include <iostream>
#include <utility>

#include "components/support/devices.h"

namespace OvTool {

std::string tooLarge(std::uint64_t mostBytes) {
    return "is larger than " + std::to_string(mostBytes) + " bytes; --max-size allows more";
}

Ov::RnRef<Ov::RnBufferedIO> openStandardInput(std::uint64_t mostBytes, std::string& error) {
    static bool opened = false;
    if (std::exchange(opened, true)) {
        error = "standard input can be read only once";
        return {};
    }
    std::string bytes;
    char block[65536];
    while (std::cin.read(block, sizeof block), std::cin.gcount() > 0) {
        bytes.append(block, static_cast<std::size_t>(std::cin.gcount()));
        if (bytes.size() <= mostBytes) continue;
        error = tooLarge(mostBytes);
        return {};
    }
    return Ov::rnCreate<Ov::RnMemoryBuffer>(bytes);
}

}  // namespace OvTool
