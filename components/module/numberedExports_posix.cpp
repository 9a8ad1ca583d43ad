#include "ovphoto/numberedExports.h"

#include "components/photo/naturallight/calendar.h"
#include "components/photo/naturallight/clock.h"
#include "components/photo/naturallight/timeZones.h"

// The inner cast changes nothing: it makes the compiler check each function's type.
#define OVPHOTO_EXPORT_ENTRY(number, name) \
    {number, reinterpret_cast<void (*)()>( \
                 static_cast<decltype(OvPhotometrics::NumberedFunctions::name)>(&OvPhotometrics::name))},

const RnNumberedExport RnNumberedExports[] = {{1, reinterpret_cast<void (*)()>(&RnGetComponentDescription)},
                                              OVPHOTO_NUMBERED_EXPORTS(OVPHOTO_EXPORT_ENTRY){0, nullptr}};
