#include "tools/ovphoto/hostSession.h"

#include <algorithm>
#include <filesystem>
#include <iterator>

#include "components/support/devices.h"
#include "components/support/file.h"
#include "components/support/path.h"
#include "host/componentManager/streamEx.h"
#include "ovphoto/classIds.h"
#include "tools/ovphoto/closeFormats.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/messageCollector.h"
#include "tools/ovphoto/platform.h"
#include "tools/ovphoto/standardStreams.h"

namespace OvTool {

using namespace Ov;

namespace {

std::wstring findModule() {
    const std::filesystem::path folder = executableFolder();
    for (const auto& place : {folder / moduleFileName(), folder.parent_path() / "lib" / moduleFileName()}) {
        std::error_code error;
        if (std::filesystem::exists(place, error)) return widePath(place);
    }
    throw ExModule(std::string(moduleFileName()) +
                   " lies neither beside the tool nor in ../lib; --module names it");
}

/// "libOVphoto.so" and the like; not the companion with its texts, on systems where that is named so, too.
bool isModuleName(const std::filesystem::path& file) {
    const std::wstring stem = widePath(file.stem());
    return stem.starts_with(L"libOV") && !stem.ends_with(L"Res") &&
           file.extension() == std::filesystem::path(moduleFileName()).extension();
}

/// Loads the modules that lie beside one: what is named as such and has the entry point of one.
void loadNeighbours(RnComponentManager& manager, const Module& module) {
    const std::filesystem::path own = nativePath(module.path());
    std::error_code ignored;
    for (const std::filesystem::path& path : pathsIn(own.parent_path(), ignored)) {
        const std::wstring name = widePath(path);
        if (path != own && isModuleName(path.filename()) && Module(name).byName("RnGetComponentDescription"))
            manager.loadModule(name.c_str());
    }
}

std::wstring pathOf(const std::string& file) { return fromUtf8(isStandardStream(file) ? "stdin" : file); }

int lineOf(const ReadResult& result, std::size_t message) {
    return message < result.lines.size() ? result.lines[message] : 0;
}

/// What stands behind a message that was reported several times in a row, from this line on.
std::string lineText(int line, std::size_t times) {
    const std::string where = line > 0 ? inLanguage("line ", "Zeile ") + std::to_string(line) : "";
    if (times == 1) return where.empty() ? "" : " (" + where + ")";
    return " (" + std::to_string(times) + inLanguage(" times", "-mal") +
           (where.empty() ? "" : inLanguage(", from ", ", ab ") + where + inLanguage(" on", "")) + ")";
}

/// The bytes of an input from its start on, up to and with the one at `position` where there is one.
std::string bytesTo(RnBufferedIO& io, long position) {
    constexpr std::ptrdiff_t blockSize = 1 << 16;
    std::string bytes;
    io.seek(0, 0);
    for (int count = 1; count > 0 && std::ssize(bytes) <= position;) {
        const std::size_t before = bytes.size();
        const auto wanted = std::min<std::ptrdiff_t>(position + 1 - std::ssize(bytes), blockSize);
        bytes.resize(before + static_cast<std::size_t>(wanted));
        count = io.readBytes(bytes.data() + before, static_cast<int>(wanted));
        bytes.resize(before + static_cast<std::size_t>(std::max(count, 0)));
    }
    return bytes;
}

/// The lines that positions lie in, which end in CR LF, LF or CR; behind the end it is the last with anything on it. 0
/// where nothing of the line has been read: the fault lies elsewhere then, as in a tilt file.
std::vector<int> linesAt(RnBufferedIO& io, const std::vector<long>& positions) {
    const std::string bytes = bytesTo(io, *std::max_element(positions.begin(), positions.end()));
    std::vector<std::size_t> starts{0};
    for (std::size_t i = 0; i < bytes.size(); ++i) {
        const bool ends = bytes[i] == '\n' || (bytes[i] == '\r' && i + 1 < bytes.size() && bytes[i + 1] != '\n');
        if (ends) starts.push_back(i + 1);
    }
    std::vector<int> lines;
    for (const long position : positions) {
        auto place = static_cast<std::size_t>(std::max(position, 0L));
        if (place >= bytes.size()) place = bytes.find_last_not_of(" \t\r\n\x1A") + 1;
        const auto next = std::upper_bound(starts.begin(), starts.end(), place);
        lines.push_back(*std::prev(next) == place ? 0 : static_cast<int>(next - starts.begin()));
    }
    return lines;
}

}  // namespace

std::vector<std::string> ReadResult::reasons() const {
    std::vector<std::string> all;
    for (std::size_t i = 0; i < messages.size(); ++i) all.push_back(messages[i] + lineText(lineOf(*this, i), 1));
    if (!error.empty()) all.push_back(error);
    return all;
}

std::vector<std::string> ReadResult::told() const {
    if (verbose) return reasons();
    const std::size_t count = messages.size() - (!web && messages.size() > 1 ? 1 : 0);
    std::vector<std::string> texts;
    for (std::size_t i = 0, end = 0; i < count; i = end) {
        for (end = i + 1; end < count && messages[end] == messages[i];) ++end;
        texts.push_back(messages[i] + lineText(lineOf(*this, i), end - i));
    }
    if (!error.empty()) texts.push_back(error);
    return texts;
}

HostSession::HostSession(const std::string& modulePath)
    : _manager(rnCast<RnComponentManager>(RnGetComponentManager())) {
    const std::wstring path = modulePath.empty() ? findModule() : fromUtf8(modulePath);
    _module = &_manager->loadModule(path.c_str());
    loadNeighbours(*_manager, *_module);
    _formats = Formats(*_manager);
}

OvPhotometrics::NumberedFunctions HostSession::functions() const {
    const auto functions = OvPhotometrics::numberedFunctions(*_module);
#define OVPHOTO_CHECK_EXPORT(number, name) \
    if (!functions.name) throw ExModule("the module lacks its function " #number);
    OVPHOTO_NUMBERED_EXPORTS(OVPHOTO_CHECK_EXPORT)
#undef OVPHOTO_CHECK_EXPORT
    return functions;
}

ReadResult HostSession::read(const std::string& file, const std::string& as) const {
    return readFrom(file, as, [&](std::string& error) { return openFile(file, error); });
}

ReadResult HostSession::readBytes(const std::string& bytes, const std::string& file, const std::string& as) const {
    return readFrom(file, as,
                    [&](std::string&) -> RnRef<RnBufferedIO> { return rnCreate<RnMemoryBuffer>(bytes); });
}

template <class Open>
ReadResult HostSession::readFrom(const std::string& file, const std::string& as, Open open) const {
    ReadResult result;
    result.file = file;
    result.verbose = _verbose;
    RnRef<RnBufferedIO> io;
    std::vector<long> positions;  // of the input at each message
    try {
        const MessageCollector collector(result.messages, [&] { positions.push_back(io ? io->seek(0, 1) : 0); });
        io = open(result.error);
        if (io) import(*io, result, as);
    } catch (const RnStreamEx::ExReadError& refusal) {
        // A reader that refuses a file has reported why; a failing device has not.
        if (result.messages.empty()) result.error = std::string("cannot be read: ") + refusal.getReason();
    } catch (...) {
        result.error = currentExceptionText();
    }
    if (io && !result.web) explainRefusal(*io, result, positions, as);
    return result;
}

/// Adds lines to the messages of a reader that does not name them itself, or what the input may be instead.
void HostSession::explainRefusal(RnBufferedIO& io, ReadResult& result, const std::vector<long>& positions,
                                 const std::string& as) const {
    try {
        const std::string close = result.format.empty() || !as.empty() ? closeFormat(io, _formats) : "";
        if (!close.empty()) result.error += (result.error.empty() ? "" : ": ") + close;
        const bool namesLines = !result.reader || result.reader->traits.namesLines;
        if (!namesLines && !positions.empty() && !canBeRead(io, result)) result.lines = linesAt(io, positions);
    } catch (...) {  // of a device that fails
    }
}

/// Whether it is the values of a file that are refused, not their text: then no line has the fault.
bool HostSession::canBeRead(RnBufferedIO& io, const ReadResult& result) const {
    std::vector<std::string> unheard;
    const MessageCollector collector(unheard);
    auto skip = rnVisitor<const FileFact&>([](const FileFact&) {});
    io.seek(0, 0);
    return result.reader->own && result.reader->own->readFacts(io, pathFolder(pathOf(result.file)).c_str(), skip);
}

void HostSession::import(RnBufferedIO& io, ReadResult& result, const std::string& as) const {
    const Format* const format = as.empty() ? _formats.recognise(io) : _formats.named(as);
    if (!format) {
        result.error = as.empty() ? unknownFormat : "the module has no reader for " + as + " files";
        return;
    }
    result.format = format->name;
    result.reader = format;
    const std::wstring path = pathOf(result.file), name = pathStem(path), folder = pathFolder(path);
    auto collect = rnVisitor<const FileFact&>([&result](const FileFact& fact) {
        result.facts.push_back({fact.kind, fact.key, fact.text, fact.own});
    });
    const auto object = format->own ? format->own->importWithFacts(io, name.c_str(), folder.c_str(), collect)
                                    : format->builder->import(&io, name.c_str(), folder.c_str());
    result.web = rnCast<RnPhotoWebData>(object.get());
}

RnRef<RnWebIntensityDist> HostSession::lightOf(RnPhotoWebData& web) const {
    const auto file = rnQuery<RnPhotoFileWeb>(&web);
    const auto inCandela = file ? file->inCandela() : RnRef<RnPhotoWebData>::share(&web);
    auto light = distribute(*inCandela, inCandela->getLumens());
    light->setPeakIntensity(inCandela->getMaxCandela());
    return light;
}

RnRef<RnWebIntensityDist> HostSession::distribute(RnPhotoWebData& web, float lumens) const {
    const auto object = _manager->createObject(OvPhotometrics::classIds::webDistribution);
    auto distribution = rnCast<RnWebIntensityDist>(object.get());
    distribution->setWeb(&web);
    distribution->setFlux(lumens);
    return distribution;
}

namespace {

std::uint64_t mostBytes = 256 << 20;

}  // namespace

void setLargestInput(std::uint64_t bytes) { mostBytes = bytes; }
std::uint64_t largestInput() { return mostBytes; }

RnRef<RnBufferedIO> openFile(const std::string& file, std::string& error) {
    if (isStandardStream(file)) return openStandardInput(mostBytes, error);
    const std::wstring path = fromUtf8(file);
    std::error_code code;
    const std::uintmax_t size = std::filesystem::file_size(nativePath(path), code);
    if (!code && size > mostBytes) {
        error = tooLarge(mostBytes);
        return {};
    }
    if (auto io = openInputFile(path.c_str())) return io;
    const std::filesystem::file_status status = std::filesystem::status(nativePath(path), code);
    if (std::filesystem::is_directory(status)) {
        error = "is a folder";
    } else if (std::filesystem::exists(status) && !std::filesystem::is_regular_file(status)) {
        error = "is no regular file";
    } else {
        error = code ? "cannot be opened: " + code.message() : "cannot be opened";
    }
    return {};
}

namespace {

template <class Take>
auto takeExceptionText(Take take) {
    try {
        throw;
    } catch (const ExBase& error) {
        return take(error.getReason());
    } catch (const std::bad_alloc&) {
        return take("not enough memory");
    } catch (const std::exception& error) {
        return take(error.what());
    } catch (...) {
        return take("failed for an unknown reason");
    }
}

}  // namespace

std::string currentExceptionText() {
    return takeExceptionText([](const char* text) { return std::string(text); });
}

void tellCurrentException(void (*tell)(const char* text)) { takeExceptionText(tell); }

}  // namespace OvTool
