#pragma once

#include <filesystem>
#include <set>
#include <string>
#include <vector>

// What tests ask of the operating system; one source file for each.

/// A new empty folder of its own.
std::filesystem::path makeTemporaryFolder();

/// Sets a variable of the process's environment; an empty value counts as none.
void setVariable(const char* name, const char* value);

/// Things that are there and are neither regular files nor folders, some made in `folder`: none where the file
/// system knows no such things.
std::vector<std::filesystem::path> irregularFiles(const std::filesystem::path& folder);

/// Whether the C library's printf keeps every rule of its standard, and can judge others.
extern const bool printfIsExact;

/// Whether the operators new and delete of a program are those of its libraries, too.
extern const bool heapIsShared;

/// Compiles messages ("5 text", one a line, the text as it is) to a catalogue that replaces the file.
void compileCatalogue(const std::filesystem::path& file, const std::string& messages);

/// The names that a module exports, and whether this process has it loaded.
std::set<std::string> exportedNames(const std::filesystem::path& module);
bool isLoaded(const std::filesystem::path& module);
