#pragma once

#include "host/componentManager/builder.h"

#if defined(_WIN32)
#define OVPHOTO_EXPORT
#else
#define OVPHOTO_EXPORT __attribute__((visibility("default")))
#endif

extern "C" {

/// The entry point, export 1 and the module's only named function: its builders. The object is static; no reference is
/// taken. Type of the address: RnGetComponentDescriptionFunction.
OVPHOTO_EXPORT Ov::RnComponentRegistry* RnGetComponentDescription();
}

using RnGetComponentDescriptionFunction = Ov::RnComponentRegistry*();
