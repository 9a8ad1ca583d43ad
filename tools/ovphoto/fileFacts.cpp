#include "tools/ovphoto/fileFacts.h"

#include <algorithm>
#include <cmath>
#include <map>
#include <set>
#include <utility>

#include "components/support/path.h"
#include "tools/numbers/numbers.h"

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
        L"lumensPerLamp",     L"photometry",       L"ballastFactor", L"flux",
        L"ballastLampFactor", L"photometricType",  L"symmetryCode",  L"symmetryCode1",
        L"symmetryCode2",     L"orientationAngle", L"referenceFlux", L"encoding"};
    return std::find(std::begin(keys), std::end(keys), key) != std::end(keys);
}

/// Whether a file holds the value for want of another.
bool saysNothing(const Fact& fact) {
    static constexpr std::pair<std::wstring_view, std::wstring_view> defaults[] = {
        {L"tilt", L"NONE"},     {L"lamps", L"1"},           {L"format", L"IESNA91"},
        {L"leadInteger", L"1"}, {L"trailerInteger", L"99"}, {L"kindCode", L"3"},
        {L"auxValue1", L"1"},   {L"auxValue2", L"5"},       {L"unitTriple", L"1 1 1"}};
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
    std::erase_if(text, [](wchar_t c) { return c <= L' ' || c == 127; });
    return text;
}

constexpr std::wstring_view more = L"[MORE]";
constexpr std::wstring_view other = L"[OTHER]";

/// A label line without its blanks, the keyword in front.
std::wstring lineOf(const Fact& fact) {
    const std::wstring text = withoutBlanks(fact.text);
    return isKeyword(fact.key) ? L"[" + fact.key + L"]" + text : text;
}

/// The label lines of a file; each stands for one of another file.
class LabelLines {
public:
    explicit LabelLines(const std::vector<Fact>& facts) {
        std::wstring whole;
        const auto addWhole = [&] {
            if (const std::size_t end = whole.find(more); end != whole.npos) _continued[withoutMore(whole)] = end;
            whole.clear();
        };
        for (const Fact& fact : facts) {
            if (!isLabel(fact.key)) continue;
            const std::wstring line = lineOf(fact);
            _lines.insert(line);
            if (!line.starts_with(more)) addWhole();
            whole += line;
        }
        addWhole();
    }

    /// Whether the line stands here: as it is, under a keyword for lines without one, or its text alone.
    bool take(const Fact& fact) {
        const std::wstring line = lineOf(fact);
        const std::wstring text = withoutBlanks(fact.text);
        if (line.empty() || takeLine(line) || takeLine(std::wstring(other) + line)) return true;
        return (!text.empty() && takeLine(text)) || startsContinued(line) ||
               startsContinued(std::wstring(other) + line);
    }

private:
    bool takeLine(const std::wstring& line) {
        const auto found = _lines.find(line);
        if (found == _lines.end()) return false;
        _lines.erase(found);
        return true;
    }
    bool startsContinued(const std::wstring& line) const {
        const auto found = _continued.lower_bound(line);
        return found != _continued.end() && line.size() > found->second && found->first.starts_with(line);
    }
    static std::wstring withoutMore(const std::wstring& whole) {
        std::wstring text;
        for (std::size_t at = 0, end = 0; end != whole.npos; at = end + more.size()) {
            end = whole.find(more, at);
            text += whole.substr(at, end - at);
        }
        return text;
    }

    std::multiset<std::wstring> _lines;
    std::map<std::wstring, std::size_t> _continued;  // those that go on in further lines, whole, and where
};

/// The first of several numbers, and the others.
std::pair<std::wstring, std::wstring> firstAndRest(const std::wstring& numbers) {
    const std::size_t blank = std::min(numbers.find(L' '), numbers.size());
    return {numbers.substr(0, blank), numbers.substr(blank)};
}

/// What of a fact is no matter of the web: of several factors all but the first.
Fact ownPart(const Fact& fact) {
    return {fact.key, fact.key == L"factors" ? firstAndRest(fact.text).second : fact.text};
}

/// Whether a file has a multiplier beside its fluxes that is not their quotient, as written with two decimals.
bool hasOwnMultiplier(const std::vector<Fact>& facts) {
    const auto flux = factNumber(facts, L"flux"), reference = factNumber(facts, L"referenceFlux");
    const auto multiplier = factNumber(facts, L"multiplier");
    return flux && reference && multiplier &&
           std::abs(double{*multiplier} * *reference - *flux) > 0.005 + 1e-6 * *flux;
}

/// Whether another file has the same number or choice.
bool holds(const std::vector<Fact>& facts, const Fact& own) {
    const std::wstring* text = findFact(facts, own.key);
    return text && ownPart({own.key, *text}).text == own.text;
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
    LabelLines labels(output);
    const bool sized = hasDimension(source);
    const bool multiplied = hasOwnMultiplier(source) && !hasOwnMultiplier(output);
    const auto isKept = [&](const Fact& fact) {
        if (isLabel(fact.key)) return labels.take(fact);
        if (fact.key == L"multiplier") return !multiplied;
        const Fact own = ownPart(fact);
        return isOfWeb(own.key) || saysNothing(own) || (own.key == L"units" && !sized) || holds(output, own);
    };
    std::vector<Fact> dropped;
    for (const Fact& fact : source)
        if (!isKept(fact)) dropped.push_back(fact);
    return dropped;
}

}  // namespace OvTool
