// A module with one builder and two numbered exports; without them where TEST_MODULE_EMPTY is set.

#include "ovphoto/numberedExports.h"
#include "testBuilders.h"

#if !defined(TEST_MODULE_EMPTY)

namespace {
int twice(int value) { return 2 * value; }
int thrice(int value) { return 3 * value; }
}  // namespace

Ov::RnComponentRegistry* RnGetComponentDescription() {
    static Ov::ThingBuilder builder({7, 7, 7, 7}, L"Module Thing", L"From a module");
    static Ov::ThingRegistry registry({&builder});
    return &registry;
}

const RnNumberedExport RnNumberedExports[] = {
    {422, reinterpret_cast<void (*)()>(&twice)},
    {431, reinterpret_cast<void (*)()>(&thrice)},
    {0, nullptr},
};

#endif
