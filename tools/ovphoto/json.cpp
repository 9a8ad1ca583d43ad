#include "tools/ovphoto/json.h"

#include <iostream>

namespace OvTool {

namespace {

/// Spells the control characters that JSON may hold as they are, DEL and U+0080 to U+009F, as escapes.
std::string withoutControls(const std::string& json) {
    static constexpr char digits[] = "0123456789abcdef";
    std::string result;
    for (std::size_t i = 0; i < json.size(); ++i) {
        const bool pair = json[i] == '\xc2' && (json[i + 1] & 0xe0) == 0x80;
        if (pair) ++i;
        if (pair || json[i] == '\x7f')
            result.append("\\u00").append({digits[(json[i] & 0xf0) >> 4], digits[json[i] & 15]});
        else
            result += json[i];
    }
    return result;
}

}  // namespace

void printLine(const Json& object) {
    std::cout << withoutControls(object.dump(-1, ' ', false, Json::error_handler_t::replace)) << '\n';
}

}  // namespace OvTool
