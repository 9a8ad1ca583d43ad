#include <windows.h>

#include "components/module/moduleEntry.h"
#include "components/photo/lid/component.h"
#include "ovphoto/module.h"

namespace {

constexpr DWORD longestPath = 504;  // the companion's is up to seven longer

}  // namespace

extern "C" BOOL WINAPI DllMain(HINSTANCE instance, DWORD reason, LPVOID processEnds) {
    if (reason == DLL_PROCESS_DETACH && !processEnds) OvPhotometrics::leaveModule();
    if (reason != DLL_PROCESS_ATTACH) return TRUE;
    DisableThreadLibraryCalls(instance);
    wchar_t path[512]{};
    GetModuleFileNameW(instance, path, longestPath);
    OvPhotometrics::enterModule(instance, path);
    return TRUE;
}

Ov::RnComponentRegistry* RnGetComponentDescription() { return &OvPhotometrics::lidComponent(); }
