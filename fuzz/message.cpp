#include "components/messageFile/message.h"
#include "fuzz/fuzz.h"
#include "host/platform/path.h"

// A message text in UTF-8, around arguments of whatever kinds it asks for. Each general argument is a text, each
// floating one a number: the calling conventions that libFuzzer knows keep the two apart, and those that no
// register holds are texts, whose addresses are numbers, too.

void OvPhotometrics::fuzz::tryInput(std::string_view bytes) {
    const std::wstring text = Ov::fromUtf8(bytes).c_str();
    const auto* const s = L"text";
    const std::wstring result =
        Ov::formatMessage(text.c_str(), 0.5, -1e300, 2.0, -0.0, 5e-324, 1e21, 123456.75, -7.0,        //
                          s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s,  //
                          s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s,  //
                          s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s,  //
                          s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s, s);
    if (text.find(L'%') == text.npos) demand(result == text, "a text without markers stands as it is");
    if (text.starts_with(L'%') && text.size() < 2) demand(result.ends_with(L": %"), "a lone mark is malformed");
    demand(result.size() <= text.size() + 99 * 5000 || result.ends_with(text), "a field has an end");
}
