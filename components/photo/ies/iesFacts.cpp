#include <algorithm>

#include "components/photo/ies/ies.h"

namespace OvPhotometrics {

namespace {

constexpr std::int32_t feet = 1;
constexpr std::int32_t metres = 2;
constexpr std::size_t lineLimit = 80;  // what every edition of the format allows
constexpr std::wstring_view edition = L"IESNA";

const wchar_t* typeName(IesPhotometricType type) {
    switch (type) {
        case IesPhotometricType::C:
            return L"C";
        case IesPhotometricType::B:
            return L"B";
        case IesPhotometricType::A:
            break;
    }
    return L"A";
}

const wchar_t* tiltText(const IesFileRecord& rec) {
    switch (rec.tiltKind) {
        case IesTiltKind::none:
            return L"NONE";
        case IesTiltKind::include:
            return L"INCLUDE";
        case IesTiltKind::file:
            break;
    }
    return rec.tiltFile.c_str();
}

/// "[MANUFAC] Acme" is keyword "MANUFAC"; the length of the keyword, or 0 for a line without one.
std::size_t keywordLength(std::wstring_view line) {
    if (!line.starts_with(L'[')) return 0;
    const std::size_t end = line.find(L']');
    const std::wstring_view keyword = line.substr(0, end).substr(1);
    const auto lower = [](wchar_t c) { return c >= L'a' && c <= L'z'; };
    return end == std::wstring_view::npos || std::any_of(keyword.begin(), keyword.end(), lower) ? 0
                                                                                                : keyword.size();
}

/// The bytes of the line of index `next`, and what follows of a longer line that the reader has cut.
std::wstring wholeLine(const IesLines& lines, std::size_t& next) {
    std::wstring line = lines[next];
    while (lines[next++].size() == lineLimit && next < lines.size() && !lines[next].starts_with(L'['))
        line += lines[next];
    return line;
}

void describeLine(const std::wstring& bytes, bool first, FileFacts& facts) {
    const std::wstring line = facts.decoded(bytes);
    const std::size_t length = keywordLength(line);
    if (length > 0) {
        const std::size_t start = line.find_first_not_of(L" \t", length + 2);
        facts.add(line.substr(1, length), start == std::wstring::npos ? L"" : line.substr(start),
                  FactKind::keyword);
    } else if (first && line.starts_with(edition)) {
        facts.add(L"format", line, FactKind::value, L"IESNA91");
    } else {
        facts.add(L"line", line, FactKind::label);
    }
}

/// Adds a line; what goes beyond the limit follows as lines that continue it.
void addLine(IesLines& lines, std::wstring_view line, const FileFacts& facts) {
    static constexpr std::wstring_view more = L"[MORE] ";
    lines.push_back(facts.take(line, lineLimit));
    while (!line.empty()) lines.push_back(std::wstring(more) + facts.take(line, lineLimit - more.size()));
}

bool hasKeyword(const IesLines& lines, std::wstring_view start) {
    return std::any_of(lines.begin(), lines.end(), [&](const auto& line) { return line.starts_with(start); });
}

}  // namespace

void iesDescribe(const IesFileRecord& rec, FileFacts& facts) {
    for (std::size_t i = 0; i < rec.lines.size();) {
        const bool first = i == 0;
        describeLine(wholeLine(rec.lines, i), first, facts);
    }
    facts.add(L"lamps", rec.lampCount, FactKind::value, L"1");
    facts.add(L"lumensPerLamp", rec.lumensPerLamp, FactKind::ofLight);
    facts.add(L"photometry", rec.lumensPerLamp < 0 ? L"absolute" : L"relative", FactKind::ofLight);
    facts.add(L"multiplier", rec.candelaMultiplier, FactKind::factor);
    facts.add(L"photometricType", typeName(rec.photometricType), FactKind::ofLight);
    facts.add(L"tilt", facts.decoded(tiltText(rec), lineLimit - std::wstring_view(L"TILT=").size()),
              FactKind::value, L"NONE");
    facts.add(L"units", rec.unitsType == feet ? L"feet" : L"metres", FactKind::value);
    if (rec.width == 0 && rec.length == 0 && rec.height == 0) facts.disown(L"units");
    facts.add(L"width", rec.width);
    facts.add(L"length", rec.length);
    facts.add(L"height", rec.height);
    facts.add(L"ballastFactor", rec.ballastFactor, FactKind::factor);
    facts.add(L"ballastLampFactor", rec.ballastLampFactor, FactKind::factor);
    facts.add(L"watts", rec.inputWatts);
}

void iesCarry(const FileFacts& facts, const std::wstring& name, IesFileRecord& rec) {
    const IesLines unknown(rec.lines.begin() + 1, rec.lines.end());
    rec.lines.resize(1);
    if (const std::wstring* format = facts.find(L"format"); format && format->starts_with(edition))
        rec.lines[0] = facts.label(*format, lineLimit);
    for (const std::wstring& line : facts.textLines())
        addLine(rec.lines, keywordLength(line) > 0 ? line : L"[OTHER] " + line, facts);
    if (!name.empty() && !hasKeyword(rec.lines, L"[LUMINAIRE]")) addLine(rec.lines, L"[LUMINAIRE] " + name, facts);
    // The format wants test and maker named.
    for (const std::wstring& line : unknown)
        if (!hasKeyword(rec.lines, line.substr(0, line.find(L']')))) rec.lines.push_back(line);

    // A web of type B whose horizontal angles start at 0 is as one of type A.
    const std::wstring* type = facts.find(L"photometricType");
    const bool oneSided = !rec.grid.horizontalAngles.empty() && rec.grid.horizontalAngles.front() >= -iesTolerance;
    if (type && *type == typeName(IesPhotometricType::B) && rec.photometricType == IesPhotometricType::A &&
        oneSided)
        rec.photometricType = IesPhotometricType::B;
    if (const std::wstring* units = facts.find(L"units")) rec.unitsType = *units == L"feet" ? feet : metres;
    facts.read(L"width", rec.width);
    facts.read(L"length", rec.length);
    facts.read(L"height", rec.height);
    facts.read(L"watts", rec.inputWatts);
}

}  // namespace OvPhotometrics
