#include "fuzz/fuzz.h"

#include <cstdint>
#include <cstdio>
#include <cstdlib>

#include "components/messageFile/message.h"
#include "components/module/registration.h"
#include "components/photo/lid/component.h"
#include "components/support/path.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/processController.h"

namespace OvPhotometrics::fuzz {

namespace {

int reported = 0;

struct Host {
    Host() {
        registerBuilders();
        Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager())->addRegistry(lidComponent());
        Ov::messageFile().setFileName(Ov::fromUtf8(OVPHOTO_BIN_DIR "/libOVphotoRes.dll").c_str());
        Ov::messageFile().getText(0);  // opens it
        Ov::setMessageReporter([](int, const wchar_t*) { ++reported; });
    }
};

}  // namespace

void demand(bool kept, const char* promise) {
    if (kept) return;
    std::fprintf(stderr, "broken promise: %s\n", promise);
    std::abort();
}

int takeMessages() { return std::exchange(reported, 0); }

}  // namespace OvPhotometrics::fuzz

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    using namespace OvPhotometrics::fuzz;
    static const Host host;
    takeMessages();
    tryInput({reinterpret_cast<const char*>(data), size});
    return 0;
}
