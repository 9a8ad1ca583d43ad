#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <functional>
#include <iostream>
#include <set>
#include <sstream>

#include "components/module/moduleEntry.h"
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

    const Module* operator->() const { return &_module; }
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
        setVariable("LC_ALL", "C");
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

TEST_F(Boundary, ShowsItsEntryPointAndNothingElse) {
    const LoadedModule module(fromUtf8(modulePath()));
    std::set<std::string> names = exportedNames(modulePath());
    names.erase("RnNumberedExports");  // stands for ordinals where the system has none
    EXPECT_EQ(names, std::set<std::string>{"RnGetComponentDescription"});
    EXPECT_EQ(module->byOrdinal(1), module->byName("RnGetComponentDescription"));
}

TEST_F(Boundary, TheRegistryFindsEveryBuilder) {
    const LoadedModule module(fromUtf8(modulePath()));
    RnComponentRegistry& registry = module->registry();
    std::set<std::wstring> names;
    auto visitor = rnVisitor<RnPtr<RnComponentBuilder>>(
        [&](RnPtr<RnComponentBuilder> builder) { names.insert(builder->getName()); });
    EXPECT_EQ(registry.enumerateBuilders(visitor), RnEnum::goOn);
    EXPECT_EQ(names,
              (std::set<std::wstring>{L"CIBSE Web", L"Diffuse Distribution", L"IES Web", L"Isotropic Distribution",
                                      L"LID Importer", L"NIMB Web", L"Natural Lighting", L"Spotlight Distribution",
                                      L"TBT Web", L"Web Distribution"}));
    EXPECT_EQ(registry.getBuilderCount(), names.size());
    const auto imports = [](const RnUid& id) {
        return id == ids::cibseWeb || id == ids::iesWeb || id == ids::nimbWeb || id == ids::tbtWeb;
    };
    for (RnUid id : {ids::cibseWeb, ids::diffuse, ids::iesWeb, ids::importer, ids::isotropic, ids::naturalLight,
                     ids::nimbWeb, ids::spotlight, ids::tbtWeb, ids::webDistribution}) {
        const auto builder = registry.getBuilder(id);
        ASSERT_TRUE(builder);
        EXPECT_TRUE(builder->hasInterface(RnBuilderDescription::iid));
        EXPECT_EQ(builder->hasInterface(RnImportBuilder::iid), imports(id));
        EXPECT_EQ(builder->isCreatable(), id != ids::importer);
        EXPECT_TRUE(builder->create());
        for (std::uint32_t* word : {&id.w0, &id.w1, &id.w2, &id.w3}) {
            ++*word;
            EXPECT_FALSE(registry.getBuilder(id));
            --*word;
        }
    }
    int seen = 0;
    auto stopping = rnVisitor<RnPtr<RnComponentBuilder>>([&](RnPtr<RnComponentBuilder>) {
        ++seen;
        return RnEnum::stop;
    });
    EXPECT_EQ(registry.enumerateBuilders(stopping), RnEnum::stop);
    EXPECT_EQ(seen, 1);
}

TEST_F(Boundary, NumberedExportsAnswerByTheirOrdinals) {
    const LoadedModule module(fromUtf8(modulePath()));
    for (std::uint32_t ordinal : {0U, 2U, 421U, 435U, 441U, 4711U, 65537U})
        EXPECT_EQ(module->byOrdinal(ordinal), nullptr);
    std::set<void*> functions;
    for (std::uint32_t ordinal = 422; ordinal <= 434; ++ordinal) functions.insert(module->byOrdinal(ordinal));
    EXPECT_EQ(functions.size(), 13U);
    EXPECT_FALSE(functions.contains(nullptr));

    EXPECT_EQ(module->byOrdinal<float(bool, int, int, bool)>(422)(true, 12, 30, true), 12.5F);
    int hours = 0, minutes = 0, month = 0, day = 0;
    bool pm = false;
    module->byOrdinal<void(bool, float, int*, int*, bool*)>(423)(true, 13.75F, &hours, &minutes, &pm);
    EXPECT_TRUE(hours == 1 && minutes == 45 && pm);
    EXPECT_STREQ(module->byOrdinal<const wchar_t*(int)>(424)(2), L"Eastern Time");
    EXPECT_EQ(module->byOrdinal<int(int)>(425)(15), 1);
    EXPECT_FLOAT_EQ(module->byOrdinal<float(int)>(426)(2), 1.3089969F);
    EXPECT_EQ(module->byOrdinal<int()>(427)(), 31);
    EXPECT_EQ(module->byOrdinal<int(float)>(428)(1.3089969F), 2);
    EXPECT_TRUE(module->byOrdinal<bool(int, float)>(429)(10, -170));
    EXPECT_STREQ(module->byOrdinal<const wchar_t*(int)>(430)(6), L"June");
    EXPECT_STREQ(module->byOrdinal<const wchar_t*(int)>(431)(6), L"Jun");
    EXPECT_EQ(module->byOrdinal<int(int)>(432)(2), 28);
    EXPECT_EQ(module->byOrdinal<int(int, int)>(433)(6, 21), 172);
    EXPECT_TRUE(module->byOrdinal<bool(int, int*, int*)>(434)(172, &month, &day));
    EXPECT_TRUE(month == 6 && day == 21);
    EXPECT_STREQ(module.functions().getMonthShortName(5), L"May");
}

TEST(CompanionPath, ReplacesTheExtensionOfTheFile) {
    using OvPhotometrics::companionPath;
    EXPECT_EQ(companionPath(L"C:\\x\\libOVphoto.dll"), L"C:\\x\\libOVphotoRes.dll");
    EXPECT_EQ(companionPath(L"C:\\a.b\\lib"), L"C:\\a.b\\libRes.dll");
    EXPECT_EQ(companionPath(L"/a.b/lib"), L"/a.b/libRes.dll");
    EXPECT_EQ(companionPath(L"lib.so.1"), L"lib.soRes.dll");
    EXPECT_EQ(companionPath(L"x.y:z"), L"x.y:zRes.dll");
    EXPECT_EQ(companionPath(L"C:/a.b\\c/lib.x.dll"), L"C:/a.b\\c/lib.xRes.dll");
    EXPECT_EQ(companionPath(L"C:\\a.b/lib"), L"C:\\a.b/libRes.dll");
    EXPECT_EQ(companionPath(L""), L"Res.dll");
    // As long as the name of a module can be where that is limited: no more than seven characters come to it.
    const std::wstring longest = L"C:\\" + std::wstring(497, L'x');
    EXPECT_EQ(companionPath(longest + L".dll"), longest + L"Res.dll");
    EXPECT_EQ(companionPath(longest + L"yyyy"), longest + L"yyyyRes.dll");
}

}  // namespace
