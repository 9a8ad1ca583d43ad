#include "fuzz/fuzz.h"

namespace OvPhotometrics::fuzz {

bool isDue(std::string_view input, std::size_t part, std::size_t values) {
    return values <= 1 << 17 && std::hash<std::string_view>()(input) % 128 == part;
}

/// libFuzzer bounds memory and time itself.
void measured(std::size_t, const std::function<void()>& work) { work(); }

}  // namespace OvPhotometrics::fuzz
