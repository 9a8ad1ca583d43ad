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

std::wstring withoutBlanks(std::wstring text) {
    std::erase_if(text, [](wchar_t c) { return c <= L' ' || c == 127; });
    return text;
}

constexpr std::wstring_view more = L"[MORE]";
constexpr std::wstring_view other = L"[OTHER]";

/// A label line without its blanks, the keyword in front.
std::wstring lineOf(const Fact& fact) {
    const std::wstring text = withoutBlanks(fact.text);
    return fact.kind == FactKind::keyword ? L"[" + fact.key + L"]" + text : text;
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
            if (!fact.isLabel()) continue;
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

/// Whether another file has the same number or choice.
bool holds(const std::vector<Fact>& facts, const Fact& own) {
    return std::any_of(facts.begin(), facts.end(), [&](const Fact& fact) {
        return fact.key == own.key && (fact.own == own.own || fact.text == own.text);
    });
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
    const auto isKept = [&](const Fact& fact) {
        return fact.isLabel() ? labels.take(fact) : fact.own.empty() || holds(output, fact);
    };
    std::vector<Fact> dropped;
    for (const Fact& fact : source)
        if (!isKept(fact)) dropped.push_back(fact);
    return dropped;
}

}  // namespace OvTool
