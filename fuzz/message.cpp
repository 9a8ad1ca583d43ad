#include "components/messageFile/message.h"

#include <utility>

#include "components/support/path.h"
#include "fuzz/fuzz.h"

// A message text in UTF-8, around arguments of whatever kinds it asks for.

namespace {

/// Each general argument is a text, each floating one a number: the calling conventions of the machines that fuzz
/// keep the two apart, and beyond the registers the address of a text is a number, too.
template <std::size_t... k>
std::wstring formatted(const std::wstring& text, std::index_sequence<k...>) {
    return Ov::formatMessage(text.c_str(), 0.5, -1e300, 2.0, -0.0, 5e-324, 1e21, 123456.75, -7.0,
                             (static_cast<void>(k), L"text")...);
}

}  // namespace

void OvPhotometrics::fuzz::tryInput(std::string_view bytes) {
    const std::wstring text = Ov::fromUtf8(bytes).c_str();
    const std::wstring result = formatted(text, std::make_index_sequence<99>());
    demand(text.find(L'%') != text.npos || result == text, "a text without markers stands as it is");
    demand(!text.ends_with(L"%") || text.ends_with(L"%%") || result == L"MALFORMED FORMATTING STRING: " + text,
           "a mark at the end is malformed");
    demand(result.size() <= text.size() + 99 * 5000, "a field has an end");
}
