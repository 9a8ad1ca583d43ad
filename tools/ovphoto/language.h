#pragma once

namespace OvTool {

/// The one of two texts that is in the language of the module's own: German, or English for all others. Before a
/// module is loaded, English.
const char* inLanguage(const char* english, const char* german);

}  // namespace OvTool
