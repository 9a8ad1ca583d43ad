#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <iostream>
#include <sstream>

#include "components/support/devices.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/module.h"
#include "host/componentManager/processController.h"
#include "host/componentManager/stream.h"
#include "ovphoto/classIds.h"
#include "ovphoto/intensityDist.h"
#include "ovphoto/numberedExports.h"
#include "ovphoto/photoFormat.h"
#include "support/paths.h"
#include "tests/support/tempFolder.h"

// What passes between a host and the built module: exceptions both ways, and the module itself, again and again.

namespace {

using namespace Ov;
namespace ids = OvPhotometrics::classIds;

constexpr const char* goodFile = "IESNA91\nTILT=NONE\n1 100 1 2 1 1 2 0 0 0 1 1 0 0 90 0 5 1";

RnRef<RnComponentManager> manager() { return rnCast<RnComponentManager>(RnGetComponentManager()); }

/// A module that is loaded as long as the object lives.
class LoadedModule {
public:
    explicit LoadedModule(std::wstring path)
        : _path(std::move(path)), _module(manager()->loadModule(_path.c_str())) {}
    LoadedModule(const LoadedModule&) = delete;
    LoadedModule& operator=(const LoadedModule&) = delete;
    ~LoadedModule() { manager()->unloadModule(_path.c_str()); }

    OvPhotometrics::NumberedFunctions functions() const { return OvPhotometrics::numberedFunctions(_module); }

private:
    std::wstring _path;
    const Module& _module;
};

RnRef<RnImportBuilder> iesImporter() { return rnCast<RnImportBuilder>(manager()->findBuilder(ids::iesWeb).get()); }

RnRef<RnIntensityDist> lamp() {
    auto lamp = rnCast<RnIntensityDist>(manager()->createObject(ids::diffuse).get());
    lamp->setFlux(1000);
    return lamp;
}

class Boundary : public testing::Test {
protected:
    Boundary() {
        setMessageReporter([this](int, const wchar_t* text) { reported += text; });
    }
    ~Boundary() override { setMessageReporter(nullptr); }

    template <class Handled, class F>
    static void isCaught(F raise) {
        EXPECT_THROW(raise(), Handled);
    }

    /// `raise` ends in an exception that a handler of each of these classes catches, and of ExBase.
    template <class... Handled, class F>
    static void raises(F raise) {
        (isCaught<Handled>(raise), ...);
        try {
            raise();
            ADD_FAILURE() << "nothing is raised";
        } catch (const ExBase& failure) {
            EXPECT_STRNE(failure.getReason(), "");
            EXPECT_NE(failure.getDetailedReason().find(failure.getReason()), std::string::npos);
        }
    }

    TempFolder folder;
    std::wstring reported;
};

/// Fails like a broken disk where a host may well have no exception of the library's.
struct DeviceFailure {
    int code;
};

class FailingInput : public RnMemoryBuffer {
    bool readMore() override { throw DeviceFailure{7}; }
};

TEST_F(Boundary, TheHostsHandlersCatchWhatTheModuleRaises) {
    const LoadedModule module(fromUtf8(modulePath()));
    const auto importer = iesImporter();
    const std::wstring bad = folder.write("bad.ies", "IESNA91\nTILT=NONE\n0");
    raises<RnStreamEx::ExReadError, RnStreamEx, std::runtime_error>(
        [&] { importer->import(bad.c_str(), nullptr); });
    EXPECT_NE(reported.find(L"is 0; it must be at least 1"), std::wstring::npos) << toUtf8(reported);
    raises<ExBadCast, std::bad_cast>([&] { importer->canImport(static_cast<RnBufferedIO*>(nullptr)); });
    const auto source = lamp();
    raises<ExAssertion, std::logic_error>([&] { source->toLocalNormalized({0, 0, 0}); });

    std::ostringstream full;
    full.setstate(std::ios::badbit);
    RnStream out(rnCreate<RnOutBuffer>(&full).get(), RnStream::Form::text);
    for (const auto& builder : manager()->builders(L"Photometric Web"))
        if (const auto format = rnQuery<RnPhotoFormat>(builder.get()))
            raises<RnStreamEx::ExWriteError, RnStreamEx, std::runtime_error>(
                [&] { format->write(*source, out, FileForm::faithful, nullptr, 0); });
    const auto object = importer->import(folder.write("good.ies", goodFile).c_str(), nullptr);
    raises<RnStreamEx::ExWriteError, RnStreamEx, std::runtime_error>([&] { out << object.get(); });
}

TEST_F(Boundary, WithoutACatalogueMessagesAreNumbersAndNamesAreTheHostsToCatch) {
    namespace fs = std::filesystem;
    const fs::path companion = fs::path(modulePath()).replace_filename("libOVphotoRes.dll");
    const fs::path own = nativePath(folder.wide("aloneRes.dll"));
    const std::wstring alone = folder.wide("alone" + fs::path(modulePath()).extension().string());
    const std::wstring cut = folder.write("cut.ies", "IESNA91");
    fs::copy_file(modulePath(), nativePath(alone));
    const struct {
        const char* name;
        std::function<void()> make;
    } cases[] = {{"missing", [] {}},
                 {"empty", [&] { folder.write("aloneRes.dll", ""); }},
                 {"of another kind", [&] { folder.write("aloneRes.dll", std::string(100000, 'x')); }},
                 {"cut short",
                  [&] {
                      fs::copy_file(companion, own);
                      fs::resize_file(own, fs::file_size(own) / 2);
                  }},
                 {"a folder", [&] { fs::create_directory(own); }}};
    for (const auto& [name, make] : cases) {
        SCOPED_TRACE(name);
        fs::remove(own);
        make();
        const LoadedModule module(alone);
        const auto functions = module.functions();
        raises<std::runtime_error>([&] { functions.getMonthName(6); });
        reported.clear();
        EXPECT_THROW(iesImporter()->import(cut.c_str(), nullptr), RnStreamEx::ExReadError);
        EXPECT_EQ(reported.substr(0, 8), L"Message ");
        // Renamed to its place, a whole one is found, and stays when another takes its place.
        fs::remove(own);
        fs::copy_file(companion, folder.path() / "new");
        fs::rename(folder.path() / "new", own);
        EXPECT_STREQ(functions.getMonthName(6), L"June");
        std::error_code isProtected;
        fs::rename(nativePath(folder.write("other", "")), own, isProtected);
        EXPECT_STREQ(functions.getMonthName(7), L"July");
    }
}

TEST_F(Boundary, WhatAHostThrowsComesBackToIt) {
    const LoadedModule module(fromUtf8(modulePath()));
    const auto importer = iesImporter();
    try {
        importer->import(rnCreate<FailingInput>().get(), L"", nullptr);
        ADD_FAILURE() << "nothing is raised";
    } catch (const DeviceFailure& failure) {
        EXPECT_EQ(failure.code, 7);
    }
    auto visitor = rnVisitor<const wchar_t*>([](const wchar_t*) { throw DeviceFailure{8}; });
    EXPECT_THROW(importer->enumerateExtensions(visitor), DeviceFailure);
    setMessageReporter([](int, const wchar_t*) { throw DeviceFailure{9}; });
    EXPECT_THROW(importer->import(folder.write("cut.ies", "IESNA91").c_str(), nullptr), DeviceFailure);
}

TEST_F(Boundary, AModuleIsUsedUnloadedAndLoadedAgain) {
    ASSERT_FALSE(isLoaded(modulePath()));
    const std::wstring good = folder.write("good.ies", goodFile), cut = folder.write("cut.ies", "IESNA91");
    std::wstring first;
    std::string saved;
    for (int round = 0; round < 3; ++round) {
        SCOPED_TRACE(round);
        {
            const LoadedModule module(fromUtf8(modulePath()));
            EXPECT_TRUE(isLoaded(modulePath()));
            const auto memory = rnCreate<RnMemoryBuffer>(saved);
            RnStream stream(memory.get(), RnStream::Form::binary);
            if (round == 0) {
                stream << lamp().get();
                saved = memory->bytes();
            } else {
                EXPECT_EQ(rnCast<RnIntensityDist>(stream.readObject(nullptr).get())->getFlux(), 1000);
            }
            const auto web = iesImporter()->import(good.c_str(), nullptr);
            EXPECT_EQ(rnCast<RnPhotoWebData>(web.get())->getMaxCandela(), 5);
            // The catalogue is opened anew, and the texts are the same.
            EXPECT_THROW(iesImporter()->import(cut.c_str(), nullptr), RnStreamEx::ExReadError);
            EXPECT_STREQ(module.functions().getMonthName(6), L"June");
        }
        EXPECT_FALSE(isLoaded(modulePath()));
        EXPECT_FALSE(manager()->findBuilder(ids::iesWeb));
        if (round == 0) first = reported;
        EXPECT_EQ(std::exchange(reported, L""), first);
    }
    EXPECT_NE(first, L"");
}

/// A static object of a host, made before the module is loaded: it ends behind whatever the module leaves to the end
/// of the process. It uses all that outlives a call.
class LateUser {
public:
    explicit LateUser(std::wstring refusedFile) : _file(std::move(refusedFile)) {
        setMessageReporter([this](int, const wchar_t* text) { _told += toUtf8(text) + '|'; });
    }
    ~LateUser() {
        use();
        use();
        std::cerr << _told << '\n';
    }

    void use() {
        const Module& module = manager()->loadModule(_module.c_str());
        EXPECT_THROW(iesImporter()->import(_file.c_str(), nullptr), RnStreamEx::ExReadError);
        _told += toUtf8(OvPhotometrics::numberedFunctions(module).getMonthName(6)) + '|';
        RnStream stream(rnCreate<RnMemoryBuffer>().get(), RnStream::Form::binary);
        stream << lamp().get();
        stream.device().seek(0, 0);
        _told += std::to_string(rnCast<RnIntensityDist>(stream.readObject(nullptr).get())->getFlux()) + '|';
    }

private:
    std::wstring _module = fromUtf8(modulePath());
    std::wstring _file;
    std::string _told;
};

TEST_F(Boundary, TheModuleServesStaticObjectsThatEndAfterMain) {
    const std::wstring cut = folder.write("cut.ies", "IESNA91");
    const auto host = [&](bool isUsedBefore) {
        setVariable("LC_ALL", "de_DE.UTF-8");
        static LateUser user(cut);
        if (isUsedBefore) user.use();
        std::exit(0);
    };
    const std::string once =
        "Die photometrische Datei kann nicht gelesen werden: Die Datei endet vor ihrer Zeile "
        "TILT=.|Juni|1000.000000|";
    EXPECT_EXIT(host(false), testing::ExitedWithCode(0), testing::EndsWith(once + once + '\n'));
    EXPECT_EXIT(host(true), testing::ExitedWithCode(0), testing::EndsWith(once + once + once + '\n'));
}

}  // namespace
