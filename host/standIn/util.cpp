#include "host/sdk/util.h"

#include <cstdlib>
#include <string_view>

#include "components/support/immortal.h"
#include "components/support/path.h"

namespace WendSDK::Util {

namespace {

struct Language {
    std::wstring name;
};

/// A module opens its texts as late as it reports.
std::wstring& currentLanguage() { return Ov::immortal<Language>().name; }

/// The value of the variable that decides about texts, or an empty text.
std::string_view localeName() {
    for (const char* variable : {"LC_ALL", "LC_MESSAGES", "LANG"}) {
        const char* value = std::getenv(variable);
        if (value && *value) return value;
    }
    return {};
}

/// `name` in lower case, or an empty text when it has other characters than letters.
std::wstring lowerLetters(const std::wstring& name) {
    std::wstring lower;
    for (const wchar_t c : name) {
        const bool capital = c >= L'A' && c <= L'Z';
        if (!capital && (c < L'a' || c > L'z')) return {};
        lower += static_cast<wchar_t>(capital ? c - L'A' + L'a' : c);
    }
    return lower;
}

}  // namespace

void UseLanguagePackLocale(void*) {
    const std::string_view name = localeName();
    setLanguage(Ov::fromUtf8(name.substr(0, name.find_first_of("_.@"))));
}

std::wstring language() { return currentLanguage(); }

void setLanguage(const std::wstring& language) {
    const std::wstring lower = lowerLetters(language);
    const bool untranslated = lower == L"c" || lower == L"posix";
    currentLanguage() = untranslated ? std::wstring() : lower;
}

}  // namespace WendSDK::Util
