#pragma once

#include <string>

// Where the build and the sources lie. One source file knows, so that a test's object code is the same in every
// build folder.

/// The folder of the built module, tool and texts.
const std::string& binFolder();
/// The top folder of the sources.
const std::string& sourceFolder();
/// The built module and the host library.
const std::string& modulePath();
const std::string& hostPath();
