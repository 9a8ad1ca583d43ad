#include "tools/ovphoto/json.h"

#include <iostream>

namespace OvTool {

void printLine(const Json& object) {
    std::cout << object.dump(-1, ' ', false, Json::error_handler_t::replace) << '\n';
}

}  // namespace OvTool
