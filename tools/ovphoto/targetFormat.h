#pragma once

#include <span>
#include <string>

#include "ovphoto/numberedExports.h"

namespace OvTool {

/// A format that files are written in.
struct TargetFormat {
    const char* name;       // "IES", as formatName gives it
    const char* extension;  // "ies"
    decltype(&OvPhotometrics::NumberedFunctions::writeIes) write;
    bool namesLines;  // in the messages of its reader
};

std::span<const TargetFormat> targetFormats();
/// By name; null for a name that is none.
const TargetFormat* targetNamed(const std::string& name);
/// By the extension of a path, in any letter case; null for another.
const TargetFormat* targetOf(const std::string& path);

}  // namespace OvTool
