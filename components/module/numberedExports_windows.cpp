#include "components/photo/naturallight/calendar.h"
#include "components/photo/naturallight/clock.h"
#include "components/photo/naturallight/timeZones.h"
#include "ovphoto/numberedExports.h"

// One jump for each export, under a name that module.def knows; the cast makes the compiler check its type.
#define OVPHOTO_EXPORT_JUMP(number, name)                                                            \
    extern "C" __attribute__((naked, used)) void RnNumberedExport##number() {                        \
        asm("jmp %P0" ::"i"(                                                                         \
            static_cast<decltype(OvPhotometrics::NumberedFunctions::name)>(&OvPhotometrics::name))); \
    }
OVPHOTO_NUMBERED_EXPORTS(OVPHOTO_EXPORT_JUMP)
