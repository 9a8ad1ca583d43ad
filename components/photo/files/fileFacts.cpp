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

constexpr std::wstring_view encodingKey = L"encoding";
constexpr std::wstring_view windows1252Name = L"Windows-1252";

/// Where the part of a text starts that says something: at its end where none does.
std::size_t ownPart(const std::wstring& text, FactKind kind, std::wstring_view usual, std::size_t from) {
    if (kind == FactKind::label || kind == FactKind::keyword) return 0;
    const bool saysNothing = text == usual || text.find_first_not_of(L"0 ", from) == std::wstring::npos;
    return kind == FactKind::value && !saysNothing ? from : text.size();
}

}  // namespace

FileFacts::FileFacts(const FileFact* facts, std::int32_t count) {
    for (std::int32_t i = 0; i < count; ++i) add(facts[i].key, std::wstring(facts[i].text), facts[i].kind);
}

void FileFacts::add(std::wstring key, std::wstring text, FactKind kind, std::wstring_view usual) {
    append(std::move(key), std::move(text), kind, usual, 0);
}

void FileFacts::add(std::wstring key, std::int32_t value, FactKind kind, std::wstring_view usual) {
    add(std::move(key), numberText(value), kind, usual);
}

void FileFacts::add(std::wstring key, float value, FactKind kind, std::wstring_view usual) {
    add(std::move(key), numberText(value), kind, usual);
}

void FileFacts::add(std::wstring key, std::span<const float> values, std::wstring_view usual,
                    std::size_t ofLight) {
    std::wstring text;
    std::size_t from = 0;
    for (std::size_t i = 0; i < values.size(); ++i) {
        if (i == ofLight) from = text.size();
        text += (text.empty() ? L"" : L" ") + numberText(values[i]);
    }
    append(std::move(key), std::move(text), FactKind::value, usual, from);
}

void FileFacts::append(std::wstring key, std::wstring text, FactKind kind, std::wstring_view usual,
                       std::size_t from) {
    const std::size_t ownFrom = ownPart(text, kind, usual, from);
    _facts.push_back({std::move(key), std::move(text), kind, ownFrom});
}

void FileFacts::disown(std::wstring_view key) {
    for (Fact& fact : _facts)
        if (fact.key == key) fact.ownFrom = fact.text.size();
}

std::wstring FileFacts::decoded(std::wstring_view bytes, std::size_t limit) {
    if (const auto encoding = encodingOf(bytes, limit); encoding && _encoding != LabelEncoding::utf8)
        _encoding = encoding;
    return textOfLabel(bytes, limit);
}

void FileFacts::addEncoding() {
    if (_encoding)
        add(std::wstring(encodingKey),
            *_encoding == LabelEncoding::utf8 ? L"UTF-8" : std::wstring(windows1252Name), FactKind::ofLight);
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
    for (const Fact& fact : _facts) {
        if (fact.kind != FactKind::keyword && fact.kind != FactKind::label) continue;
        const std::wstring line = labelText(fact.text, anyLength);
        const bool bare = line.find_first_not_of(L' ') == std::wstring::npos;
        if (fact.kind == FactKind::keyword)
            lines.push_back(L"[" + fact.key + (bare ? L"]" : L"] " + line));
        else if (!bare)
            lines.push_back(line);
    }
    return lines;
}

std::vector<FileFact> FileFacts::list() const {
    std::vector<FileFact> facts;
    for (const auto& [key, text, kind, ownFrom] : _facts)
        facts.push_back({kind, key.c_str(), text.c_str(), text.c_str() + ownFrom});
    return facts;
}

void FileFacts::visit(Ov::RnEnumerator<const FileFact&>& visitor) const {
    for (const FileFact& fact : list())
        if (visitor.visit(fact) != Ov::RnEnum::goOn) return;
    visitor.finish();
}

bool isBareKeyword(std::wstring_view line) { return line.starts_with(L'[') && line.find(L']') == line.size() - 1; }

}  // namespace OvPhotometrics
