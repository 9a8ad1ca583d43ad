#include "tools/ovphoto/fileFacts.h"

#include <algorithm>

#include "host/platform/path.h"
#include "tools/ovphoto/numbers.h"

namespace OvTool {

using namespace Ov;

namespace {

/// Header keywords are in capitals.
bool isKeyword(std::wstring_view key) {
    return std::none_of(key.begin(), key.end(), [](wchar_t c) { return c >= L'a' && c <= L'z'; });
}

bool isLabel(std::wstring_view key) {
    return key == L"title" || key == L"line" || key.starts_with(L"line ") || key.starts_with(L"label ") ||
           isKeyword(key);
}

bool isOfWeb(std::wstring_view key) {
    static constexpr std::wstring_view keys[] = {
        L"format",        L"lamps",         L"lumensPerLamp", L"photometry",        L"multiplier",
        L"ballastFactor", L"factors",       L"flux",          L"ballastLampFactor", L"photometricType",
        L"symmetryCode",  L"symmetryCode1", L"symmetryCode2", L"orientationAngle",  L"referenceFlux"};
    return std::find(std::begin(keys), std::end(keys), key) != std::end(keys);
}

/// Whether a file holds the value for want of another.
bool saysNothing(const Fact& fact) {
    static constexpr std::pair<std::wstring_view, std::wstring_view> defaults[] = {
        {L"tilt", L"NONE"},   {L"leadInteger", L"1"}, {L"trailerInteger", L"99"}, {L"kindCode", L"3"},
        {L"auxValue1", L"1"}, {L"auxValue2", L"5"},   {L"unitTriple", L"1 1 1"}};
    return fact.text.find_first_not_of(L"0 ") == std::wstring::npos ||
           std::find(std::begin(defaults), std::end(defaults),
                     std::pair<std::wstring_view, std::wstring_view>(fact.key, fact.text)) != std::end(defaults);
}

/// Units mean nothing without a dimension.
bool hasDimension(const std::vector<Fact>& facts) {
    return std::any_of(facts.begin(), facts.end(), [](const Fact& fact) {
        return (fact.key == L"width" || fact.key == L"length" || fact.key == L"height") && !saysNothing(fact);
    });
}

std::wstring withoutBlanks(std::wstring text) {
    std::erase_if(text, [](wchar_t c) { return c <= L' '; });
    return text;
}

/// The text of all label lines, keywords in front. A line that was continued on another is whole.
std::wstring labelsOf(const std::vector<Fact>& facts) {
    std::wstring labels;
    for (const Fact& fact : facts) {
        if (!isLabel(fact.key)) continue;
        if (isKeyword(fact.key) && fact.key != L"MORE") labels += L"[" + fact.key + L"]";
        labels += withoutBlanks(fact.text);
    }
    return labels;
}

}  // namespace

const std::wstring* findFact(const std::vector<Fact>& facts, std::wstring_view key) {
    const auto found = std::find_if(facts.begin(), facts.end(), [&](const Fact& fact) { return fact.key == key; });
    return found == facts.end() ? nullptr : &found->text;
}

std::optional<float> factNumber(const std::vector<Fact>& facts, std::wstring_view key) {
    const std::wstring* text = findFact(facts, key);
    return text ? parseFloat(toUtf8(*text)) : std::nullopt;
}

Json factsToJson(const std::vector<Fact>& facts) {
    Json array = Json::array();
    for (const Fact& fact : facts) array.push_back({{"key", toUtf8(fact.key)}, {"value", toUtf8(fact.text)}});
    return array;
}

std::vector<Fact> droppedFacts(const std::vector<Fact>& source, const std::vector<Fact>& output) {
    const std::wstring labels = labelsOf(output);
    const bool sized = hasDimension(source);
    const auto isKept = [&](const Fact& fact) {
        if (isLabel(fact.key)) return labels.find(withoutBlanks(fact.text)) != std::wstring::npos;
        if (isOfWeb(fact.key) || saysNothing(fact) || (fact.key == L"units" && !sized)) return true;
        const std::wstring* text = findFact(output, fact.key);
        return text && *text == fact.text;
    };
    std::vector<Fact> dropped;
    std::copy_if(source.begin(), source.end(), std::back_inserter(dropped), std::not_fn(isKept));
    return dropped;
}

}  // namespace OvTool
