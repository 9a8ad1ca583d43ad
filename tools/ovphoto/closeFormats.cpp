#include "tools/ovphoto/closeFormats.h"

#include <algorithm>
#include <sstream>

#include "components/support/devices.h"
#include "tools/numbers/numbers.h"

namespace OvTool {

namespace {

using namespace std::string_view_literals;

std::string firstBytes(Ov::RnBufferedIO& io) {
    std::string bytes(4096, '\0');
    io.seek(0, 0);
    const int count = io.readBytes(bytes.data(), static_cast<int>(bytes.size()));
    io.seek(0, 0);
    bytes.resize(static_cast<std::size_t>(std::max(count, 0)));
    return bytes;
}

/// With its mark, or as letters of ASCII, which have a NUL each.
bool isUtf16(std::string_view bytes) {
    if (bytes.starts_with("\xFF\xFE") || bytes.starts_with("\xFE\xFF")) return true;
    const std::string_view start = bytes.substr(0, 16);
    return start.size() == 16 && std::count(start.begin(), start.end(), '\0') == 8;
}

/// Behind the company's name each line holds one number: kind of light (1 to 3) and symmetry (0 to 4), then planes and
/// the step between them, then angles in a plane and the step between those.
bool isEulumdat(const std::string& bytes) {
    constexpr float most[] = {3, 4, 721, 360, 361, 180};
    std::istringstream lines(bytes);
    std::string line;
    std::getline(lines, line);
    for (std::size_t i = 0; i < std::size(most); ++i) {
        if (!std::getline(lines, line)) return false;
        line.erase(line.find_last_not_of(" \t\r") + 1);
        line.erase(0, line.find_first_not_of(" \t"));
        std::replace(line.begin(), line.end(), ',', '.');
        const auto number = parseFloat(line);
        if (!number || *number < (i == 0 ? 1 : 0) || *number > most[i]) return false;
    }
    return true;
}

}  // namespace

std::string closeFormat(Ov::RnBufferedIO& io, const Formats& formats) {
    const std::string bytes = firstBytes(io);
    if (bytes.empty()) return "it is empty";
    if (bytes.starts_with("\x1F\x8B")) return "it is compressed by gzip, to be unpacked first";
    if (bytes.starts_with("PK\3\4"sv)) return "it is a zip archive, to be unpacked first";
    if (isUtf16(bytes)) return "it is text in UTF-16, to be saved in UTF-8 or ANSI first";
    if (isEulumdat(bytes)) return "it looks like EULUMDAT, which is not read";
    if (bytes.find('\r') == std::string::npos || bytes.find('\n') != std::string::npos) return {};
    // Readers take such lines where content tests do not.
    std::string other = bytes;
    std::replace(other.begin(), other.end(), '\r', '\n');
    const Format* const reader = formats.recognise(*Ov::rnCreate<Ov::RnMemoryBuffer>(other));
    return "its lines end in carriage returns alone" +
           (reader ? "; --as " + reader->extension + " takes them" : std::string());
}

}  // namespace OvTool
