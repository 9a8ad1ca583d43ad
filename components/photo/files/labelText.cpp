#include "components/photo/files/labelText.h"

#include <algorithm>
#include <iterator>

#include "components/support/path.h"

namespace OvPhotometrics {

namespace {

/// Windows-1252 from 0x80 on; what lies above is Latin-1.
constexpr wchar_t windows1252[] = {0x20ac, 0x81,   0x201a, 0x0192, 0x201e, 0x2026, 0x2020, 0x2021,
                                   0x02c6, 0x2030, 0x0160, 0x2039, 0x0152, 0x8d,   0x017d, 0x8f,
                                   0x90,   0x2018, 0x2019, 0x201c, 0x201d, 0x2022, 0x2013, 0x2014,
                                   0x02dc, 0x2122, 0x0161, 0x203a, 0x0153, 0x9d,   0x017e, 0x0178};

bool isAscii(wchar_t c) { return static_cast<char32_t>(c) < 0x80; }
bool isByte(wchar_t c) { return static_cast<char32_t>(c) <= 0xff; }
bool isFirstHalf(wchar_t c) { return c >= 0xd800 && c < 0xdc00; }
bool isSecondHalf(wchar_t c) { return c >= 0xdc00 && c < 0xe000; }

wchar_t fromWindows1252(wchar_t byte) { return byte >= 0x80 && byte < 0xa0 ? windows1252[byte - 0x80] : byte; }

/// The byte of a character, or one above 255.
wchar_t toWindows1252(wchar_t c) {
    if (c < 0x80 || (c >= 0xa0 && c <= 0xff)) return c;
    const auto* const found = std::find(std::begin(windows1252), std::end(windows1252), c);
    return found == std::end(windows1252) ? L'\xffff' : static_cast<wchar_t>(0x80 + (found - windows1252));
}

std::wstring mapped(std::wstring_view text, wchar_t (*map)(wchar_t)) {
    std::wstring result(text.size(), L'\0');
    std::transform(text.begin(), text.end(), result.begin(), map);
    return result;
}

/// Whether the character of this index is half of one that takes two, or a byte that stands for itself.
bool isLoneHalf(std::wstring_view text, std::size_t i) {
    return isSecondHalf(text[i]) && (i == 0 || !isFirstHalf(text[i - 1]));
}

std::optional<std::wstring> fromUtf8(std::wstring_view bytes) {
    std::string narrow(bytes.size(), '\0');
    std::transform(bytes.begin(), bytes.end(), narrow.begin(), [](wchar_t c) { return static_cast<char>(c); });
    std::wstring text = Ov::fromUtf8(narrow);
    for (std::size_t i = 0; i < text.size(); ++i)
        if (isLoneHalf(text, i)) return {};
    return text;
}

/// How many bytes at the end are the beginning of a character in UTF-8.
std::size_t cutBytes(std::wstring_view bytes) {
    std::size_t count = 0;
    while (count < std::min<std::size_t>(bytes.size(), 3)) {
        const wchar_t c = bytes[bytes.size() - ++count];
        if (c >= 0xc2 && c < 0xf5) return count < (c < 0xe0 ? 2U : c < 0xf0 ? 3U : 4U) ? count : 0;
        if (c < 0x80 || c >= 0xc0) return 0;
    }
    return 0;
}

bool hasMore(std::wstring_view text) { return !std::all_of(text.begin(), text.end(), isAscii); }

/// The text where the bytes are UTF-8 beyond ASCII.
std::optional<std::wstring> utf8Text(std::wstring_view bytes, std::size_t limit) {
    if (!hasMore(bytes) || !std::all_of(bytes.begin(), bytes.end(), isByte)) return {};
    if (auto text = fromUtf8(bytes)) return text;
    if (bytes.size() < limit) return {};
    bytes.remove_suffix(cutBytes(bytes));
    return hasMore(bytes) ? fromUtf8(bytes) : std::nullopt;
}

std::wstring encoded(std::wstring_view text, LabelEncoding wanted) {
    if (wanted == LabelEncoding::windows1252) {
        std::wstring bytes = mapped(text, toWindows1252);
        if (std::all_of(bytes.begin(), bytes.end(), isByte) && textOfLabel(bytes) == text) return bytes;
    }
    const std::string utf8 = Ov::toUtf8(text);
    std::wstring bytes(utf8.size(), L'\0');
    std::transform(utf8.begin(), utf8.end(), bytes.begin(),
                   [](char c) { return static_cast<wchar_t>(static_cast<unsigned char>(c)); });
    return bytes;
}

bool isControl(wchar_t c) { return c <= 0x1f || c == 0x7f; }

}  // namespace

std::optional<LabelEncoding> encodingOf(std::wstring_view bytes, std::size_t limit) {
    if (!hasMore(bytes)) return {};
    return utf8Text(bytes, limit) ? LabelEncoding::utf8 : LabelEncoding::windows1252;
}

std::wstring textOfLabel(std::wstring_view bytes, std::size_t limit) {
    if (auto text = utf8Text(bytes, limit)) return *text;
    return mapped(bytes, fromWindows1252);
}

std::wstring takeLabel(std::wstring_view& text, std::size_t limit, LabelEncoding wanted) {
    std::wstring clean = labelText(text, limit);  // a character takes a byte at the least
    for (std::size_t i = 0; i < clean.size(); ++i)
        if (isLoneHalf(clean, i) && clean[i] >= 0xdc80 && clean[i] <= 0xdcff)
            clean[i] = fromWindows1252(static_cast<wchar_t>(clean[i] - 0xdc00));
    std::wstring bytes = encoded(clean, wanted);
    while (bytes.size() > limit || (!clean.empty() && clean.size() < text.size() && isFirstHalf(clean.back()))) {
        clean.pop_back();
        bytes = encoded(clean, wanted);
    }
    text.remove_prefix(clean.size());
    return bytes;
}

std::wstring labelText(std::wstring_view text, std::size_t limit) {
    std::wstring label(text.substr(0, limit));
    std::replace_if(label.begin(), label.end(), isControl, L' ');
    return label;
}

}  // namespace OvPhotometrics
