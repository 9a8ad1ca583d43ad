#include "tools/ovphoto/iesFacts.h"

#include <charconv>

#include "tools/ovphoto/numbers.h"

namespace OvTool {

namespace {

/// The numbers of a file, one token after another. A token that is no number makes every later answer empty.
class Tokens {
public:
    explicit Tokens(std::string_view text) : _rest(text) {}

    std::optional<float> next() {
        const std::size_t start = _rest.find_first_not_of(separators);
        if (start == std::string_view::npos) return {};
        _rest.remove_prefix(start);
        const std::string_view token = _rest.substr(0, _rest.find_first_of(separators));
        _rest.remove_prefix(token.size());
        return parseFloat(token);
    }
    bool skip(float count) {
        for (float i = 0; i < count; ++i) {
            if (!next()) return false;
        }
        return true;
    }

private:
    static constexpr std::string_view separators{" \t\r\n\v\f,\x1a\0", 9};

    std::string_view _rest;
};

/// The text behind "TILT=" at the start of a line, that line's rest included.
std::optional<std::string_view> behindTilt(std::string_view bytes) {
    constexpr std::string_view mark = "TILT=";
    for (std::size_t at = 0; at < bytes.size();) {
        if (bytes.substr(at).starts_with(mark)) return bytes.substr(at + mark.size());
        const std::size_t end = bytes.find_first_of("\r\n", at);
        if (end == std::string_view::npos) return {};
        at = end + 1;
    }
    return {};
}

bool isWord(std::string_view text, std::string_view word) {
    if (text.size() < word.size()) return false;
    for (std::size_t i = 0; i < word.size(); ++i) {
        const char c = text[i];
        if ((c >= 'a' && c <= 'z' ? static_cast<char>(c - 'a' + 'A') : c) != word[i]) return false;
    }
    return text.find_first_not_of(" \t\v\f", word.size()) == std::string_view::npos;
}

bool skipTiltBlock(Tokens& tokens) {
    if (!tokens.next()) return false;
    const auto pairs = tokens.next();
    return pairs && tokens.skip(2 * *pairs);
}

}  // namespace

std::optional<IesFacts> readIesFacts(std::string_view bytes) {
    const auto tail = behindTilt(bytes);
    if (!tail) return {};
    const std::string_view tilt = tail->substr(0, tail->find_first_of("\r\n"));
    Tokens tokens(tail->substr(tilt.size()));
    if (isWord(tilt, "INCLUDE") && !skipTiltBlock(tokens)) return {};

    float values[13];  // from the lamp count to the watts
    for (float& value : values) {
        const auto token = tokens.next();
        if (!token) return {};
        value = *token;
    }
    if (!tokens.skip(values[3])) return {};
    const auto firstHorizontal = tokens.next();
    if (!firstHorizontal) return {};

    IesFacts facts;
    facts.hasTilt = !isWord(tilt, "NONE");
    facts.candelaMultiplier = values[2];
    facts.photometricType = values[5] == 1 ? 1 : values[5] == 2 ? 2 : 3;
    facts.ballastFactor = values[10];
    facts.ballastLampFactor = values[11];
    facts.firstHorizontalAngle = *firstHorizontal;
    return facts;
}

}  // namespace OvTool
