#pragma once

#include <string>

#include "host/base/hostApi.h"

namespace WendSDK::Util {

/// Sets the language in which modules show their texts from the first of LC_ALL, LC_MESSAGES and LANG that is not
/// empty. `moduleInstance` names the module that asks; it is not used here.
OVHOST_API void UseLanguagePackLocale(void* moduleInstance);

/// The language set so, such as L"de"; empty before, and for "C" and "POSIX". Only lower-case letters.
OVHOST_API std::wstring language();
/// Sets it directly; the empty text goes back to the modules' own texts. Anything but letters counts as empty.
OVHOST_API void setLanguage(const std::wstring& language);

}  // namespace WendSDK::Util
