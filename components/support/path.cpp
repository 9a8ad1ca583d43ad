#include "components/support/path.h"

#include <cstddef>

namespace Ov {

namespace {

constexpr char32_t byteBase = 0xDC00;
constexpr char32_t lastCharacter = 0x10FFFF;
constexpr char32_t replacement = 0xFFFD;

bool isHighSurrogate(char32_t c) { return c >= 0xD800 && c < 0xDC00; }
bool isLowSurrogate(char32_t c) { return c >= 0xDC00 && c < 0xE000; }
bool isCharacter(char32_t c) { return c <= lastCharacter && !isHighSurrogate(c) && !isLowSurrogate(c); }
bool isByte(char32_t c) { return c >= byteBase + 0x80 && c <= byteBase + 0xFF; }

std::size_t lengthByLead(unsigned char lead) {
    if (lead < 0x80) return 1;
    if (lead < 0xC2) return 0;
    if (lead < 0xE0) return 2;
    if (lead < 0xF0) return 3;
    return lead < 0xF5 ? 4 : 0;
}

/// Reads the character that `text` starts with; its length, or 0 where no UTF-8 stands.
std::size_t decode(std::string_view text, char32_t& c) {
    static constexpr char32_t smallest[] = {0, 0, 0x80, 0x800, 0x10000};
    const auto lead = static_cast<unsigned char>(text[0]);
    const std::size_t length = lengthByLead(lead);
    if (length == 0 || length > text.size()) return 0;
    c = length == 1 ? lead : lead & (0x7Fu >> length);
    for (const char next : text.substr(1, length - 1)) {
        const auto byte = static_cast<unsigned char>(next);
        if ((byte & 0xC0) != 0x80) return 0;
        c = c << 6 | (byte & 0x3Fu);
    }
    return c >= smallest[length] && isCharacter(c) ? length : 0;
}

void appendUtf8(std::string& out, char32_t c) {
    const auto trail = [&](int shift) { out += static_cast<char>(0x80 | (c >> shift & 0x3F)); };
    if (c < 0x80) {
        out += static_cast<char>(c);
    } else if (c < 0x800) {
        out += static_cast<char>(0xC0 | c >> 6);
    } else if (c < 0x10000) {
        out += static_cast<char>(0xE0 | c >> 12);
        trail(6);
    } else {
        out += static_cast<char>(0xF0 | c >> 18);
        trail(12);
        trail(6);
    }
    if (c >= 0x80) trail(0);
}

void appendWide(std::wstring& out, char32_t c) {
    if (sizeof(wchar_t) == 2 && c >= 0x10000) {
        out += static_cast<wchar_t>(0xD800 + ((c - 0x10000) >> 10));
        out += static_cast<wchar_t>(0xDC00 + (c & 0x3FF));
    } else {
        out += static_cast<wchar_t>(c);
    }
}

}  // namespace

std::string toUtf8(std::wstring_view text) {
    std::string out;
    out.reserve(text.size());
    for (std::size_t i = 0; i < text.size(); ++i) {
        auto c = static_cast<char32_t>(text[i]);
        if (isHighSurrogate(c) && i + 1 < text.size() && isLowSurrogate(static_cast<char32_t>(text[i + 1]))) {
            c = 0x10000 + ((c & 0x3FF) << 10) + (static_cast<char32_t>(text[++i]) & 0x3FF);
        }
        if (isByte(c)) {
            out += static_cast<char>(c - byteBase);
        } else {
            appendUtf8(out, isCharacter(c) ? c : replacement);
        }
    }
    return out;
}

std::wstring fromUtf8(std::string_view text) {
    std::wstring out;
    out.reserve(text.size());
    while (!text.empty()) {
        char32_t c = 0;
        std::size_t length = decode(text, c);
        if (length == 0) {
            c = byteBase + static_cast<unsigned char>(text[0]);
            length = 1;
        }
        appendWide(out, c);
        text.remove_prefix(length);
    }
    return out;
}

std::wstring pathStem(std::wstring_view path) { return widePath(nativePath(path).stem()); }

std::wstring pathFolder(std::wstring_view path) {
    const std::filesystem::path folder = nativePath(path).parent_path();
    return folder.empty() ? L"." : widePath(folder);
}

}  // namespace Ov
