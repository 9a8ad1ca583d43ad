#pragma once

// Marks what the host library (OVhost) shares with the modules and tools that link it.
#if defined(_WIN32)
#if defined(OVHOST_BUILD)
#define OVHOST_API __declspec(dllexport)
#else
#define OVHOST_API __declspec(dllimport)
#endif
#else
#define OVHOST_API __attribute__((visibility("default")))
#endif
