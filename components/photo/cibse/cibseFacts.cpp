#include <algorithm>

#include "components/photo/cibse/cibse.h"

namespace OvPhotometrics {

namespace {

std::wstring labelKey(std::size_t index) { return L"label " + std::to_wstring(index + 1); }

/// The labels of another CIBSE file. False when there are none.
bool carryLabels(const FileFacts& facts, CibseRecord& rec) {
    bool any = false;
    for (std::size_t i = 0; i < rec.labels.size(); ++i) {
        const std::wstring* text = facts.find(labelKey(i));
        if (!text) continue;
        rec.labels[i] = facts.label(*text, cibseLabelLimit);
        any = true;
    }
    return any;
}

/// The name, unless a line holds it, and as many lines as there is room for; those that say least go first.
void carryLines(const FileFacts& facts, const std::wstring& name, CibseRecord& rec) {
    std::vector<std::wstring> lines = facts.textLines();
    const bool named =
        std::any_of(lines.begin(), lines.end(), [&](const auto& line) { return line.find(name) != line.npos; });
    if (!named) lines.insert(lines.begin(), name);
    if (lines.size() > rec.labels.size()) std::erase_if(lines, isBareKeyword);
    for (std::size_t i = 0; i < std::min(lines.size(), rec.labels.size()); ++i)
        rec.labels[i] = facts.label(lines[i], cibseLabelLimit);
}

}  // namespace

void cibseDescribe(const CibseRecord& rec, FileFacts& facts) {
    for (std::size_t i = 0; i < rec.labels.size(); ++i)
        if (rec.labels[i].find_first_not_of(L' ') != std::wstring::npos)
            facts.add(labelKey(i), facts.decoded(rec.labels[i], cibseLabelLimit), FactKind::label);
    facts.add(L"leadInteger", rec.leadInteger, FactKind::value, L"1");
    facts.add(L"photometricType", static_cast<std::int32_t>(rec.photometricType), FactKind::ofLight);
    facts.add(L"leadValues", rec.leadValues);
    facts.add(L"factors", rec.factors, {}, 1);
    facts.add(L"singleValue", rec.singleValue);
    facts.add(L"trailerInteger", rec.trailerInteger, FactKind::value, L"99");
    facts.add(L"trailerValues", rec.trailerValues);
}

void cibseCarry(const FileFacts& facts, const std::wstring& name, CibseRecord& rec) {
    if (!carryLabels(facts, rec)) carryLines(facts, name, rec);
    facts.read(L"leadInteger", rec.leadInteger);
    rec.leadInteger = std::max(rec.leadInteger, 1);  // a reader takes no other
    facts.read(L"leadValues", rec.leadValues);
    const float factor = rec.factors[0];  // belongs to the candelas
    facts.read(L"factors", rec.factors);
    rec.factors[0] = factor;
    facts.read(L"singleValue", rec.singleValue);
    facts.read(L"trailerInteger", rec.trailerInteger);
    facts.read(L"trailerValues", rec.trailerValues);
}

}  // namespace OvPhotometrics
