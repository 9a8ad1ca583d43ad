#include "components/photo/files/fileFacts.h"

#include <algorithm>
#include <charconv>

namespace OvPhotometrics {

namespace {

constexpr std::size_t anyLength = std::wstring::npos;

template <class Number>
std::wstring numberText(Number value) {
    char text[64];
    return {text, std::to_chars(text, text + sizeof text, value).ptr};
}

/// Takes `values` from the blank-separated numbers of `text`, which must be as many.
template <class Number>
bool parseNumbers(std::wstring_view text, std::span<Number> values) {
    std::string narrow(text.size(), '?');
    std::transform(text.begin(), text.end(), narrow.begin(),
                   [](wchar_t c) { return c > 0 && c < 128 ? static_cast<char>(c) : '?'; });
    const char* next = narrow.data();
    const char* const end = next + narrow.size();
    std::vector<Number> parsed;
    while (next != end) {
        const auto result = std::from_chars(next, end, parsed.emplace_back());
        if (result.ec != std::errc() || (result.ptr != end && *result.ptr != ' ')) return false;
        next = std::find_if(result.ptr, end, [](char c) { return c != ' '; });
    }
    if (parsed.size() != values.size()) return false;
    std::copy(parsed.begin(), parsed.end(), values.begin());
    return true;
}

/// Keywords are written in capitals, the names of numbers are not.
bool isKeyword(std::wstring_view key) {
    return !key.empty() && std::none_of(key.begin(), key.end(), [](wchar_t c) { return c >= L'a' && c <= L'z'; });
}

constexpr std::wstring_view encodingKey = L"encoding";
constexpr std::wstring_view windows1252Name = L"Windows-1252";

bool isLabel(std::wstring_view key) {
    return key == L"title" || key == L"line" || key.starts_with(L"line ") || key.starts_with(L"label ");
}

}  // namespace

void FileFacts::add(std::wstring key, std::wstring text) { _facts.push_back({std::move(key), std::move(text)}); }

void FileFacts::add(std::wstring key, std::int32_t value) { add(std::move(key), numberText(value)); }

void FileFacts::add(std::wstring key, float value) { add(std::move(key), numberText(value)); }

void FileFacts::add(std::wstring key, std::span<const float> values) {
    std::wstring text;
    for (const float value : values) text += (text.empty() ? L"" : L" ") + numberText(value);
    add(std::move(key), std::move(text));
}

std::wstring FileFacts::decoded(std::wstring_view bytes, std::size_t limit) {
    if (const auto encoding = encodingOf(bytes, limit); encoding && _encoding != LabelEncoding::utf8)
        _encoding = encoding;
    return textOfLabel(bytes, limit);
}

void FileFacts::addEncoding() {
    if (_encoding)
        add(std::wstring(encodingKey),
            *_encoding == LabelEncoding::utf8 ? L"UTF-8" : std::wstring(windows1252Name));
}

std::wstring FileFacts::take(std::wstring_view& text, std::size_t limit) const {
    const std::wstring* name = find(encodingKey);
    return takeLabel(text, limit,
                     name && *name == windows1252Name ? LabelEncoding::windows1252 : LabelEncoding::utf8);
}

const std::wstring* FileFacts::find(std::wstring_view key) const {
    const auto found = std::find_if(begin(), end(), [&](const Fact& fact) { return fact.key == key; });
    return found == end() ? nullptr : &found->text;
}

bool FileFacts::read(std::wstring_view key, std::int32_t& value) const {
    const std::wstring* text = find(key);
    return text && parseNumbers(*text, std::span(&value, 1));
}

bool FileFacts::read(std::wstring_view key, float& value) const { return read(key, std::span(&value, 1)); }

bool FileFacts::read(std::wstring_view key, std::span<float> values) const {
    const std::wstring* text = find(key);
    return text && parseNumbers(*text, values);
}

std::vector<std::wstring> FileFacts::textLines() const {
    std::vector<std::wstring> lines;
    for (const auto& [key, text] : _facts) {
        if (!isKeyword(key) && !isLabel(key)) continue;
        const std::wstring line = labelText(text, anyLength);
        const bool bare = line.find_first_not_of(L' ') == std::wstring::npos;
        if (isKeyword(key))
            lines.push_back(L"[" + key + (bare ? L"]" : L"] " + line));
        else if (!bare)
            lines.push_back(line);
    }
    return lines;
}

bool isBareKeyword(std::wstring_view line) { return line.starts_with(L'[') && line.find(L']') == line.size() - 1; }

}  // namespace OvPhotometrics
