#include <algorithm>
#include <exception>
#include <string_view>

#include "components/messageFile/messageIds.h"
#include "components/photo/files/numberText.h"
#include "components/photo/lid/reportMessage.h"
#include "components/photo/nimb/nimb.h"

namespace OvPhotometrics {

namespace {

constexpr int largestField = 9999;
constexpr int largestIdentifier = 99999999;

bool fitsField(std::int32_t number) { return number >= -999 && number <= largestField; }
bool fitsIdentifier(std::int32_t number) { return number >= -999 && number <= largestIdentifier; }

bool headerFits(const NimbRecord& rec) {
    const std::int32_t numbers[] = {rec.psiMax,
                                    rec.thetaMax,
                                    rec.psiStep,
                                    rec.thetaStep,
                                    rec.orientationAngle,
                                    rec.spare1,
                                    rec.spare2,
                                    rec.spare3,
                                    std::max(rec.symmetryCode1, 0),
                                    std::max(rec.symmetryCode2, 0)};
    return fitsIdentifier(rec.identifier) && std::all_of(std::begin(numbers), std::end(numbers), fitsField);
}

/// A number, or as many blanks where there is none.
void writeField(Ov::RnStream& s, bool present, int width, std::int32_t number) {
    if (present)
        s.formattedWrite(L"%*d", width, number);
    else
        s.formattedWrite(L"%*s", width, L" ");
}

void writeHeader(const NimbRecord& rec, Ov::RnStream& s) {
    const bool large = rec.identifier > largestField;
    s.formattedWrite(L"%4d", large ? -1 : rec.identifier);
    s.formattedWrite(L"%4d%4d%4d%4d%4d%4d%4d%4dNIMB", rec.psiMax, rec.thetaMax, rec.psiStep, rec.thetaStep,
                     rec.orientationAngle, rec.spare1, rec.spare2, rec.spare3);
    writeField(s, large, 8, rec.identifier);
    writeField(s, rec.symmetryCode1 >= 0, 4, rec.symmetryCode1);
    writeField(s, rec.symmetryCode2 >= 0, 4, rec.symmetryCode2);
    endLine(s);
}

void writeText(std::wstring line, Ov::RnStream& s) {
    line.resize(std::min<std::size_t>(line.size(), nimbLineLength));
    std::replace_if(
        line.begin(), line.end(), [](wchar_t c) { return c == L'\n' || c == L'\r'; }, L' ');
    writeLine(s, L"%s", line.c_str());
}

void writeValues(const std::vector<std::int16_t>& values, Ov::RnStream& s) {
    for (std::size_t k = 0; k < values.size(); ++k) {
        if (k > 0 && k % nimbValuesPerLine == 0) endLine(s);
        s.formattedWrite(L"%4d", std::clamp<int>(values[k], -999, largestField));
    }
    endLine(s);
}

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
    carryNumber(facts, L"identifier", fitsIdentifier, rec.identifier);
    carryNumber(facts, L"spare1", fitsField, rec.spare1);
    carryNumber(facts, L"spare2", fitsField, rec.spare2);
    carryNumber(facts, L"spare3", fitsField, rec.spare3);
}

bool nimbWrite(const NimbRecord& rec, Ov::RnStream& s) {
    try {
        if (headerFits(rec)) {
            writeHeader(rec, s);
            for (const std::wstring& line : rec.lines) writeText(line, s);
            writeValues(rec.values, s);
            return true;
        }
    } catch (const std::exception&) {
    }
    reportMessage(messages::nimbNotWritten);
    return false;
}

}  // namespace OvPhotometrics
