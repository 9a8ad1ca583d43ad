#pragma once

#include <string>
#include <string_view>

namespace OvPhotometrics {

/// The companion that holds the message texts: the module's path with the file's extension replaced by "Res.dll",
/// which is appended when the file has none.
std::wstring companionPath(std::wstring_view modulePath);

/// What every platform's entry does when the module has been loaded from `modulePath`: registers the builders,
/// takes the host's language and names the companion to the catalogue, which opens it at the first message.
void enterModule(void* instance, std::wstring_view modulePath);

/// What it does before the module is unloaded: gives back the heap. Catalogue, builders and registry stay as they are,
/// without texts; so do they for whoever asks after this at the end of a process.
void leaveModule();

}  // namespace OvPhotometrics
