#include <algorithm>
#include <string_view>

#include "components/photo/nimb/nimb.h"

namespace OvPhotometrics {

namespace {

constexpr const wchar_t* lineKeys[] = {L"line 1", L"line 2", L"line 3", L"line 4"};

bool isBlank(std::wstring_view text) { return text.find_first_not_of(L' ') == text.npos; }

/// Lines made of another format's label lines; what is not there stays.
void carryLabels(const FileFacts& facts, const std::wstring& name, std::array<std::wstring, 4>& lines) {
    constexpr std::wstring_view keywords[] = {L"TEST", L"MANUFAC", L"LUMINAIRE"};
    if (!isBlank(name)) lines[2] = facts.label(name, nimbLineLength);
    for (std::size_t k = 0; k < std::size(keywords); ++k)
        if (const std::wstring* text = facts.find(keywords[k]); text && !isBlank(*text))
            lines[k] = facts.label(*text, nimbLineLength);
    for (const std::wstring& text : facts.textLines()) {
        const auto holds = [&](std::wstring_view keyword) {
            return text.starts_with(L'[') &&
                   text.compare(1, keyword.size() + 1, std::wstring(keyword) + L"]") == 0;
        };
        if (std::any_of(std::begin(keywords), std::end(keywords), holds) || text == name || isBareKeyword(text))
            continue;
        lines[3] = facts.label(text, nimbLineLength);
        return;
    }
}

void carryNumber(const FileFacts& facts, const wchar_t* key, bool (*fits)(std::int32_t), std::int32_t& number) {
    if (std::int32_t carried = 0; facts.read(key, carried) && fits(carried)) number = carried;
}

}  // namespace

void nimbDescribe(const NimbRecord& rec, FileFacts& facts) {
    for (std::size_t k = 0; k < rec.lines.size(); ++k)
        facts.add(lineKeys[k], facts.decoded(rec.lines[k], nimbLineLength), FactKind::label);
    facts.add(L"identifier", rec.identifier);
    facts.add(L"orientationAngle", rec.orientationAngle, FactKind::ofLight);
    facts.add(L"symmetryCode1", rec.symmetryCode1, FactKind::ofLight);
    facts.add(L"symmetryCode2", rec.symmetryCode2, FactKind::ofLight);
    facts.add(L"spare1", rec.spare1);
    facts.add(L"spare2", rec.spare2);
    facts.add(L"spare3", rec.spare3);
}

void nimbCarry(const FileFacts& facts, const std::wstring& name, NimbRecord& rec) {
    if (!facts.find(lineKeys[0])) carryLabels(facts, name, rec.lines);
    for (std::size_t k = 0; k < rec.lines.size(); ++k)
        if (const std::wstring* own = facts.find(lineKeys[k])) rec.lines[k] = facts.label(*own, nimbLineLength);
    carryNumber(facts, L"identifier", nimbFitsIdentifier, rec.identifier);
    carryNumber(facts, L"spare1", nimbFitsField, rec.spare1);
    carryNumber(facts, L"spare2", nimbFitsField, rec.spare2);
    carryNumber(facts, L"spare3", nimbFitsField, rec.spare3);
}

}  // namespace OvPhotometrics
