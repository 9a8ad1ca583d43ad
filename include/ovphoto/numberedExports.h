#pragma once

#include <cstdint>

#include "ovphoto/module.h"

// Functions that the module exports by number alone. A host reaches them through Ov::Module::byOrdinal, which asks
// the system where modules have ordinals, and elsewhere reads this table.

/// One entry of the table; the last has ordinal 0 and no function.
struct RnNumberedExport {
    std::uint32_t ordinal;
    void (*function)();
};

#if !defined(_WIN32)
extern "C" OVPHOTO_EXPORT const RnNumberedExport RnNumberedExports[];
#endif
