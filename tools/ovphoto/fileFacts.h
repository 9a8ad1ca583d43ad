#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "tools/ovphoto/hostSession.h"
#include "tools/ovphoto/json.h"

// What files say beyond their webs; the keys are listed in ovphoto/numberedExports.h.

namespace OvTool {

struct Fact {
    std::wstring key;
    std::wstring text;
};

/// The facts of a file that was read, in the order of the file; none when it cannot be read again.
std::vector<Fact> readFacts(const HostSession& session, const ReadResult& result);
/// The same of bytes that were read.
std::vector<Fact> readFacts(const HostSession& session, const ReadResult& result, const std::string& bytes);

/// The text of the first fact of a key, or null; and that text as a number.
const std::wstring* findFact(const std::vector<Fact>& facts, std::wstring_view key);
std::optional<float> factNumber(const std::vector<Fact>& facts, std::wstring_view key);

/// Array of {"key", "value"}.
Json factsToJson(const std::vector<Fact>& facts);

/// What stands in a file and not in another that was made of it: label lines whose text is in none of the other's,
/// and numbers and choices that it lacks. Left out is what a web carries, and what says nothing, such as a width
/// of 0.
std::vector<Fact> droppedFacts(const std::vector<Fact>& source, const std::vector<Fact>& output);

}  // namespace OvTool
