#pragma once

#include <cstdint>
#include <string>
#include <vector>

#include "host/componentManager/componentManager.h"
#include "host/componentManager/module.h"
#include "ovphoto/intensityDist.h"
#include "ovphoto/numberedExports.h"
#include "ovphoto/photoFile.h"
#include "tools/ovphoto/format.h"

namespace OvTool {

/// One thing that a file says beyond its web, as Ov::FileFact has it.
struct Fact {
    Ov::FactKind kind;
    std::wstring key;
    std::wstring text;
    std::wstring own;

    bool isLabel() const { return kind == Ov::FactKind::label || kind == Ov::FactKind::keyword; }
};

/// What became of a file that was read. Texts are UTF-8, but for file names, which may hold any bytes.
struct ReadResult {
    std::string file;                   // as the user gave it
    std::string format;                 // name of the reader's format ("IES"); empty when none was found
    const Format* reader = nullptr;     // that format, of the session
    Ov::RnRef<Ov::RnPhotoWebData> web;  // null when the file was refused
    std::vector<Fact> facts;            // in the order of the file; none when it was refused
    std::vector<std::string> messages;  // texts that the reader reported, in order
    std::vector<int> lines;             // of the input, on which it did so; 0 where that is not known
    std::string error;                  // what the tool itself has to say; empty when there is a web
    bool verbose = false;               // whether people are told everything

    /// Why the file was refused, or what was reported though it was not: the reader's texts, then the tool's own.
    std::vector<std::string> reasons() const;
    /// The same for people: equal texts in a row once and, where a file is refused for several, without the last one,
    /// which only follows from the others: a reader ends with what it missed for their sake.
    std::vector<std::string> told() const;
};

/// The tool as a host: the module is loaded, and files are read through whatever builders it brings.
class HostSession {
public:
    /// Loads the module at `modulePath`, or, when that is empty, the one beside the tool or in ../lib from there, and
    /// the other modules that lie beside it. Raises ExModule.
    explicit HostSession(const std::string& modulePath);

    /// Lets people be told everything of what is read from now on.
    void setVerbose(bool verbose) { _verbose = verbose; }
    bool verbose() const { return _verbose; }

    Ov::RnComponentManager& manager() const { return *_manager; }
    const Ov::Module& module() const { return *_module; }
    /// What the module exports by number. Raises ExModule when one is missing.
    OvPhotometrics::NumberedFunctions functions() const;

    /// The formats that the modules import.
    const Formats& formats() const { return _formats; }

    /// Reads a file, with the reader of the format `as` ("IES") or, when that is empty, of the one whose content
    /// test accepts it. Never throws for what a file holds or because it cannot be read.
    ReadResult read(const std::string& file, const std::string& as) const;
    /// The same of bytes that are, or are to be, those of the file.
    ReadResult readBytes(const std::string& bytes, const std::string& file, const std::string& as) const;

    /// The light of a web in candela, whatever the unit of its file; its flux is that of the lamps or, where the
    /// file says nothing of them, the luminaire's. Everything that the tool shows, draws and writes is this light.
    Ov::RnRef<Ov::RnWebIntensityDist> lightOf(Ov::RnPhotoWebData& web) const;
    /// A web distribution as hosts save it: the web that gives off `lumens`.
    Ov::RnRef<Ov::RnWebIntensityDist> distribute(Ov::RnPhotoWebData& web, float lumens) const;

private:
    template <class Open>
    ReadResult readFrom(const std::string& file, const std::string& as, Open open) const;
    void import(Ov::RnBufferedIO& io, ReadResult& result, const std::string& as) const;
    void explainRefusal(Ov::RnBufferedIO& io, ReadResult& result, const std::vector<long>& positions,
                        const std::string& as) const;
    bool canBeRead(Ov::RnBufferedIO& io, const ReadResult& result) const;

    Ov::RnRef<Ov::RnComponentManager> _manager;
    const Ov::Module* _module;
    Formats _formats;
    bool _verbose = false;
};

/// @{
/// The size of the largest input that `openFile` takes, in bytes: 256 MiB when it was not set.
void setLargestInput(std::uint64_t bytes);
std::uint64_t largestInput();
/// @}

/// Opens a file, or standard input as "-", for reading. When that fails it gives null and says in `error` why.
Ov::RnRef<Ov::RnBufferedIO> openFile(const std::string& file, std::string& error);

/// @{
/// What the exception in flight says; to be called in a handler. The second hands the text on without memory of its own.
std::string currentExceptionText();
void tellCurrentException(void (*tell)(const char* text));
/// @}

inline constexpr const char* unknownFormat = "not a photometric file of a known format";

}  // namespace OvTool
