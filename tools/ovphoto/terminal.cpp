#include "tools/ovphoto/terminal.h"

#include <algorithm>
#include <cstdint>
#include <cstdio>
#include <iostream>

#include "components/support/path.h"
#include "tools/ovphoto/standardStreams.h"

namespace OvTool {

namespace {

bool isPlain(std::string_view text) {
    return std::all_of(text.begin(), text.end(), [](char c) { return c >= ' ' && c < 127; });
}

bool isControl(std::uint32_t c) { return c < ' ' || (c >= 0x7f && c < 0xa0); }
bool isSeparator(std::uint32_t c) { return c == 0x2028 || c == 0x2029; }
bool turnsDirection(std::uint32_t c) {
    return c == 0x61c || c == 0x200e || c == 0x200f || (c >= 0x202a && c <= 0x202e) ||
           (c >= 0x2066 && c <= 0x2069);
}

std::wstring escape(std::uint32_t c) {
    if (c == '\n') return L"\\n";
    if (c == '\r') return L"\\r";
    char text[16];
    std::snprintf(text, sizeof text, c < 0x100 ? "\\x%02x" : "\\u%04x", static_cast<unsigned>(c));
    return {text, text + std::char_traits<char>::length(text)};
}

void printOn(std::ostream& out, std::string_view text) {
    if (isPlain(text))
        out << text << '\n';  // which takes no memory
    else
        out << printable(text) << '\n';
}

}  // namespace

std::string printable(std::string_view text) {
    if (isPlain(text)) return std::string(text);
    std::wstring shown;
    bool paired = false;  // behind the first half of a character
    for (const wchar_t wide : Ov::fromUtf8(text)) {
        const auto c = static_cast<std::uint32_t>(wide);
        const bool byte = c >= 0xdc00 && c < 0xe000 && !paired;
        paired = c >= 0xd800 && c < 0xdc00;
        if (c == '\t')
            shown += L' ';
        else if (byte || isControl(c) || isSeparator(c) || turnsDirection(c))
            shown += escape(byte ? c - 0xdc00 : c);
        else
            shown += wide;
    }
    return Ov::toUtf8(shown);
}

void say(std::string_view text) { printOn(std::cout, text); }

void sayOf(std::string_view file, std::string_view text) { isStandardStream(file) ? complain(text) : say(text); }

void complain(std::string_view text) { printOn(std::cerr, text); }

}  // namespace OvTool
