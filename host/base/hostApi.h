#pragma once

// Marks what the host library (OVhost) shares with the modules and tools that link it. Constants of its classes
// are exported on Windows only where the library itself uses their addresses, or where they are marked
// [[gnu::used]].
#if defined(_WIN32)
#if defined(OVHOST_BUILD)
#define OVHOST_API __declspec(dllexport)
#else
#define OVHOST_API __declspec(dllimport)
#endif
#else
#define OVHOST_API __attribute__((visibility("default")))
#endif
