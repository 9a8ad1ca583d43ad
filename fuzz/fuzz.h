#pragma once

#include <cstddef>
#include <functional>
#include <string_view>

// What the fuzz targets share. Each target is one source file with its own `tryInput`; linked with engine.cpp it
// is driven by libFuzzer, with replay.cpp it is a program that goes through files.

namespace OvPhotometrics::fuzz {

/// Tries one input, in a host that knows the library's builders and English texts.
void tryInput(std::string_view bytes);

/// Ends the process where a promise is broken.
void demand(bool kept, const char* promise);

/// The number of messages reported since the last call.
int takeMessages();

/// Whether the slow part `part` is tried with this input, which gives a grid of so many values: by the engine with one
/// input in 128 whose grid does not take it seconds, by the replay with all.
bool isDue(std::string_view input, std::size_t part, std::size_t values);

/// Does `work`, which reads `size` bytes. The replay holds it to the bounds of memory and time.
void measured(std::size_t size, const std::function<void()>& work);

}  // namespace OvPhotometrics::fuzz
