#include <dlfcn.h>

#include "components/module/moduleEntry.h"
#include "components/photo/lid/component.h"
#include "components/support/path.h"
#include "ovphoto/module.h"

namespace {

/// The loader runs this when it has attached the module.
__attribute__((constructor)) void attach() {
    Dl_info module;
    if (dladdr(reinterpret_cast<void*>(&attach), &module) == 0) return;
    std::error_code failure;
    const auto path = std::filesystem::absolute(module.dli_fname, failure);
    OvPhotometrics::enterModule(module.dli_fbase, Ov::widePath(failure ? module.dli_fname : path));
}

/// The loader runs this before it detaches the module: when it is unloaded, or at the end of the process, behind all
/// exit handlers, hence behind the destructors of the host's static objects.
__attribute__((destructor)) void detach() { OvPhotometrics::leaveModule(); }

}  // namespace

Ov::RnComponentRegistry* RnGetComponentDescription() { return &OvPhotometrics::lidComponent(); }
