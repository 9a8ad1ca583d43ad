#include "tools/ovphoto/hostSession.h"

#include <filesystem>

#include "host/componentManager/devices.h"
#include "host/componentManager/streamEx.h"
#include "host/platform/file.h"
#include "host/platform/path.h"
#include "ovphoto/classIds.h"
#include "tools/ovphoto/messageCollector.h"
#include "tools/ovphoto/platform.h"
#include "tools/ovphoto/standardStreams.h"

namespace OvTool {

using namespace Ov;

namespace {

constexpr const wchar_t* webCategory = L"Photometric Web";

std::wstring findModule() {
    const std::filesystem::path folder = executableFolder();
    for (const auto& place : {folder / moduleFileName(), folder.parent_path() / "lib" / moduleFileName()}) {
        std::error_code error;
        if (std::filesystem::exists(place, error)) return widePath(place);
    }
    throw ExModule(std::string(moduleFileName()) +
                   " lies neither beside the tool nor in ../lib; --module names it");
}

RnRef<RnComponentBuilder> chooseBuilder(const HostSession& session, RnBufferedIO& io, const std::string& as) {
    if (as.empty()) {
        const auto accepting = session.webImportersFor(io);
        return accepting.empty() ? RnRef<RnComponentBuilder>() : accepting.front();
    }
    for (const auto& builder : session.webImporters()) {
        if (formatName(*builder) == as) return builder;
    }
    return {};
}

}  // namespace

std::vector<std::string> ReadResult::reasons() const {
    std::vector<std::string> all = messages;
    if (!error.empty()) all.push_back(error);
    return all;
}

HostSession::HostSession(const std::string& modulePath)
    : _manager(rnCast<RnComponentManager>(RnGetComponentManager())) {
    const std::wstring path = modulePath.empty() ? findModule() : fromUtf8(modulePath);
    _module = &_manager->loadModule(path.c_str());
}

OvPhotometrics::NumberedFunctions HostSession::functions() const {
    const auto functions = OvPhotometrics::numberedFunctions(*_module);
#define OVPHOTO_CHECK_EXPORT(number, name) \
    if (!functions.name) throw ExModule("the module lacks its function " #number);
    OVPHOTO_NUMBERED_EXPORTS(OVPHOTO_CHECK_EXPORT)
#undef OVPHOTO_CHECK_EXPORT
    return functions;
}

std::vector<RnRef<RnComponentBuilder>> HostSession::webImporters() const {
    auto all = _manager->builders(webCategory);
    std::erase_if(all, [](const auto& builder) { return !builder->hasInterface(RnImportBuilder::iid); });
    return all;
}

std::vector<RnRef<RnComponentBuilder>> HostSession::webImportersFor(RnBufferedIO& io) const {
    return _manager->importersFor(webCategory, &io);
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
    try {
        const MessageCollector collector(result.messages);
        if (const RnRef<RnBufferedIO> io = open(result.error)) import(*io, result, as);
    } catch (const RnStreamEx::ExReadError& refusal) {
        // A reader that refuses a file has reported why; a failing device has not.
        if (result.messages.empty()) result.error = std::string("cannot be read: ") + refusal.getReason();
    } catch (...) {
        result.error = currentExceptionText();
    }
    return result;
}

void HostSession::import(RnBufferedIO& io, ReadResult& result, const std::string& as) const {
    const RnRef<RnComponentBuilder> builder = chooseBuilder(*this, io, as);
    if (!builder) {
        result.error = as.empty() ? unknownFormat : "the module has no reader for " + as + " files";
        return;
    }
    result.format = formatName(*builder);
    result.classId = builder->getClassId();
    if (const auto format = rnQuery<RnPhotoFormat>(builder.get())) result.traits = format->getTraits();
    const std::wstring path = fromUtf8(isStandardStream(result.file) ? "stdin" : result.file);
    auto collect = rnVisitor<const OvPhotometrics::FileFact&>([&result](const OvPhotometrics::FileFact& fact) {
        result.facts.push_back({fact.key, fact.text});
    });
    const auto object =
        functions().importWithFacts(io, result.classId, pathStem(path).c_str(), pathFolder(path).c_str(), collect);
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

std::string formatName(const RnBuilderDescription& builder) {
    std::string name = toUtf8(builder.getName());
    if (name.ends_with(" Web")) name.resize(name.size() - 4);
    return name;
}

std::string extensionOf(RnComponentBuilder& builder) {
    std::string first;
    auto takeFirst = rnVisitor<const wchar_t*>([&first](const wchar_t* extension) {
        first = toUtf8(extension);
        return RnEnum::stop;
    });
    if (const auto importer = rnQuery<RnImportBuilder>(&builder)) importer->enumerateExtensions(takeFirst);
    return first;
}

RnRef<RnBufferedIO> openFile(const std::string& file, std::string& error) {
    if (isStandardStream(file)) return openStandardInput(error);
    const std::wstring path = fromUtf8(file);
    if (auto io = openInputFile(path.c_str())) return io;
    std::error_code code;
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

std::string currentExceptionText() {
    try {
        throw;
    } catch (const ExBase& error) {
        return error.getReason();
    } catch (const std::bad_alloc&) {
        return "not enough memory";
    } catch (const std::exception& error) {
        return error.what();
    } catch (...) {
        return "failed for an unknown reason";
    }
}

}  // namespace OvTool
