#pragma once

#include <cstdint>
#include <nlohmann/json.hpp>
#include <string>
#include <vector>

namespace OvTool {

/// JSON whose members keep their order and whose numbers are floats, so that each is printed with the digits that
/// a float needs and reads back as the same float.
using Json = nlohmann::basic_json<nlohmann::ordered_map, std::vector, std::string, bool, std::int64_t,
                                  std::uint64_t, float>;

/// Prints the object on a line of its own. Bytes that are no UTF-8 become U+FFFD; control characters are escaped.
void printLine(const Json& object);

}  // namespace OvTool
