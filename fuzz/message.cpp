#include "components/messageFile/message.h"

#include <utility>

#include "components/support/path.h"
#include "fuzz/fuzz.h"

// A message text in UTF-8, around 99 arguments of all kinds.

namespace {

/// Arguments 1, 4, 7 ... are texts, 2, 5, 8 ... integers, 3, 6, 9 ... doubles.
template <std::size_t k>
auto argument() {
    if constexpr (k % 3 == 0)
        return L"text";
    else if constexpr (k % 3 == 1)
        return k % 2 == 0 ? -1 - static_cast<int>(k) : 0x7fffffff;
    else
        return k % 2 == 0 ? -1e300 : 5e-324;
}

template <std::size_t... k>
std::wstring formatted(const std::wstring& text, std::index_sequence<k...>) {
    return Ov::formatMessage(text.c_str(), argument<k>()...);
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
