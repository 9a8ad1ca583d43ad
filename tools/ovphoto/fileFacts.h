#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "tools/ovphoto/hostSession.h"
#include "tools/ovphoto/json.h"

// What files say beyond their webs.

namespace OvTool {

/// The text of the first fact of a key, or null; and that text as a number.
const std::wstring* findFact(const std::vector<Fact>& facts, std::wstring_view key);
std::optional<float> factNumber(const std::vector<Fact>& facts, std::wstring_view key);

/// Array of {"key", "value"}.
Json factsToJson(const std::vector<Fact>& facts);

/// What stands in a file and not in another that was made of it: label lines, each of which wants a line of its own
/// in the other, and numbers and choices that it lacks. Left out is what a web carries, and what says nothing, such
/// as a width of 0.
std::vector<Fact> droppedFacts(const std::vector<Fact>& source, const std::vector<Fact>& output);

}  // namespace OvTool
