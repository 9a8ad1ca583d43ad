#pragma once

#include <string>
#include <vector>

#include "tools/ovphoto/hostSession.h"

namespace OvTool {

struct ConvertOptions {
    std::vector<std::string> paths;  // the input and the output where there is no folder
    std::string folder;
    std::string as;
    std::string to;
    const Format* target = nullptr;  // as the session knows what `to` names
    std::size_t jobs = 1;
    bool asSaved = false;
    bool json = false;
    bool brief = false;  // tell people, though the report is in JSON
};

/// Converts files, and those in folders, into a folder; the exit status.
int convertIntoFolder(const ConvertOptions& options, const HostSession& session);

}  // namespace OvTool
