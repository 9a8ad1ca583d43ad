#pragma once

#include "host/componentManager/builder.h"

/// Marks what the module shows by name. On Windows a list of exports does.
#if defined(_WIN32)
#define OVPHOTO_EXPORT
#else
#define OVPHOTO_EXPORT __attribute__((visibility("default")))
#endif

extern "C" {

/// The entry point, export 1 and the module's only named function: its builders. The object is static; no
/// reference is taken. It and its builders serve any number of threads as long as the module is loaded, after `main`
/// has ended, too.
OVPHOTO_EXPORT Ov::RnComponentRegistry* RnGetComponentDescription();
}

/// Type of the entry point, for an address that was looked up.
using RnGetComponentDescriptionFunction = Ov::RnComponentRegistry*();
