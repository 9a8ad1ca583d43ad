#include "components/module/moduleEntry.h"

#include "components/messageFile/message.h"
#include "components/module/registration.h"
#include "host/sdk/util.h"

namespace OvPhotometrics {

std::wstring companionPath(std::wstring_view modulePath) {
    const std::size_t dot = modulePath.rfind(L'.');
    const bool ofFile =
        dot != std::wstring_view::npos && modulePath.find_first_of(L":/\\", dot) == std::wstring_view::npos;
    return std::wstring(ofFile ? modulePath.substr(0, dot) : modulePath) + L"Res.dll";
}

void enterModule(void* instance, std::wstring_view modulePath) {
    registerBuilders();
    Ov::RnMessageFile& catalogue = Ov::messageFile();
    WendSDK::Util::UseLanguagePackLocale(instance);
    catalogue.setFileName(companionPath(modulePath).c_str());
}

void leaveModule() { Ov::releaseTexts(); }

}  // namespace OvPhotometrics
