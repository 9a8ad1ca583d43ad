#include "tools/ovphoto/standardStreams.h"

#include <iostream>
#include <utility>

#include "host/componentManager/devices.h"

namespace OvTool {

Ov::RnRef<Ov::RnBufferedIO> openStandardInput(std::string& error) {
    static bool opened = false;
    if (!std::exchange(opened, true)) return Ov::rnCreate<Ov::RnInBuffer>(&std::cin);
    error = "standard input can be read only once";
    return {};
}

}  // namespace OvTool
