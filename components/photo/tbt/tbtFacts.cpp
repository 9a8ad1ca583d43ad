#include <algorithm>
#include <cmath>
#include <string_view>

#include "components/photo/tbt/tbt.h"

namespace OvPhotometrics {

namespace {

/// Whether the reader takes all of a line as the title.
bool canBeTitle(std::wstring_view text) { return !text.empty() && text[0] != L' ' && !text.starts_with(L"/*"); }

/// The first text that can be the title, or an empty one.
std::wstring chooseTitle(const FileFacts& facts, const std::wstring& name) {
    std::vector<std::wstring> texts;
    for (const wchar_t* key : {L"title", L"LUMINAIRE"})
        if (const std::wstring* text = facts.find(key)) texts.push_back(*text);
    texts.push_back(name);
    for (std::wstring& line : facts.textLines())
        if (!isBareKeyword(line)) texts.push_back(std::move(line));
    for (const std::wstring& text : texts)
        if (std::wstring title = facts.label(text, tbtTitleLength); canBeTitle(title)) return title;
    return {};
}

bool isReadable(float value) { return std::isfinite(value) && !std::signbit(value); }
bool isReadableShare(float value) { return isReadable(value) && value <= 1; }

/// Takes the reference flux of another TBT file and, where that file has a flux of 0, the 0: values then come out as
/// they were.
void carryUnit(const FileFacts& facts, TbtFileRecord& rec) {
    float reference = 0;
    float flux = rec.flux;
    if (!facts.read(L"referenceFlux", reference) || !isReadable(reference) || reference == 0) return;
    if (facts.read(L"flux", flux) && flux != 0) flux = rec.flux;
    tbtSetFlux(rec, flux, reference);
}

/// Whether a multiplier says more than the quotient of the two fluxes, which a record to be written has.
bool isOwnMultiplier(float multiplier, float flux, float referenceFlux) {
    constexpr double rounding = 0.005;  // of a flux with two decimals
    const double said = double{multiplier} * referenceFlux;
    return std::fabs(said - flux) > rounding + 1e-6 * flux;
}

void carryMultiplier(const FileFacts& facts, TbtFileRecord& rec) {
    float flux = 0, reference = 0, multiplier = 0;
    if (!facts.read(L"flux", flux) || !facts.read(L"referenceFlux", reference) ||
        !facts.read(L"multiplier", multiplier) || !isReadable(multiplier))
        return;
    if (isOwnMultiplier(multiplier, flux, reference)) rec.multiplier = multiplier;
}

void carryValue(const FileFacts& facts, const wchar_t* key, float& value) {
    if (float carried = 0; facts.read(key, carried) && isReadable(carried)) value = carried;
}

}  // namespace

void tbtDescribe(const TbtFileRecord& rec, FileFacts& facts) {
    facts.add(L"title", facts.decoded(rec.title, tbtTitleLength), FactKind::label);
    facts.add(L"kindCode", rec.kindCode, FactKind::value, L"3");
    const int values = tbtKindValues(rec.kindCode);
    if (values >= 1) facts.add(L"kindValue1", rec.kindValue1);
    if (values == 2) facts.add(L"kindValue2", rec.kindValue2);
    facts.add(L"unitTriple", rec.unitTriple, L"1 1 1");
    facts.add(L"flux", rec.flux, FactKind::ofLight);
    facts.add(L"referenceFlux", rec.referenceFlux, FactKind::ofLight);
    const bool isOwn = isOwnMultiplier(rec.multiplier, rec.flux, rec.referenceFlux);
    facts.add(L"multiplier", rec.multiplier, isOwn ? FactKind::value : FactKind::ofLight);
    facts.add(L"auxValue1", rec.auxValue1, FactKind::value, L"1");
    facts.add(L"auxValue2", rec.auxValue2, FactKind::value, L"5");
    facts.add(L"auxValue3", rec.auxValue3);
    facts.add(L"symmetryCode", rec.symmetryCode, FactKind::ofLight);
}

void tbtCarry(const FileFacts& facts, const std::wstring& name, TbtFileRecord& rec) {
    if (std::wstring title = chooseTitle(facts, name); !title.empty()) rec.title = std::move(title);
    if (std::int32_t code = 0; facts.read(L"kindCode", code) && tbtKindValues(code) >= 0) rec.kindCode = code;
    carryUnit(facts, rec);
    carryValue(facts, L"kindValue1", rec.kindValue1);
    carryValue(facts, L"kindValue2", rec.kindValue2);
    carryMultiplier(facts, rec);
    carryValue(facts, L"auxValue1", rec.auxValue1);
    carryValue(facts, L"auxValue2", rec.auxValue2);
    carryValue(facts, L"auxValue3", rec.auxValue3);
    if (std::array<float, 3> triple{}; facts.read(L"unitTriple", std::span<float>(triple)) &&
                                       std::all_of(triple.begin(), triple.end(), isReadableShare))
        rec.unitTriple = triple;
}

}  // namespace OvPhotometrics
