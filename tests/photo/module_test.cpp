#include <gtest/gtest.h>

#include <set>

#include "components/module/moduleEntry.h"
#include "components/support/devices.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/module.h"
#include "host/componentManager/persistant.h"
#include "host/componentManager/processController.h"
#include "host/componentManager/streamEx.h"
#include "host/sdk/util.h"
#include "ovphoto/classIds.h"
#include "ovphoto/intensityDist.h"
#include "ovphoto/numberedExports.h"
#include "ovphoto/photoFormat.h"
#include "support/paths.h"
#include "tests/support/tempFolder.h"

// The built module, reached as a host reaches it.

namespace {

class ModuleTest : public testing::Test {
protected:
    ModuleTest() : manager(Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager())) {
        setVariable("LC_ALL", "C");
        module = &manager->loadModule(path.c_str());
    }
    ~ModuleTest() override { manager->unloadModule(path.c_str()); }

    std::wstring path = Ov::fromUtf8(modulePath());
    Ov::RnRef<Ov::RnComponentManager> manager;
    const Ov::Module* module;
};

TEST_F(ModuleTest, ShowsItsEntryPointAndNothingElse) {
    std::set<std::string> names = exportedNames(modulePath());
    names.erase("RnNumberedExports");  // stands for ordinals where the system has none
    EXPECT_EQ(names, std::set<std::string>{"RnGetComponentDescription"});
    EXPECT_EQ(module->byOrdinal(1), module->byName("RnGetComponentDescription"));
}

TEST_F(ModuleTest, TheRegistryFindsEveryBuilder) {
    namespace ids = OvPhotometrics::classIds;
    Ov::RnComponentRegistry& registry = module->registry();
    std::set<std::wstring> names;
    auto visitor = Ov::rnVisitor<Ov::RnPtr<Ov::RnComponentBuilder>>(
        [&](Ov::RnPtr<Ov::RnComponentBuilder> builder) { names.insert(builder->getName()); });
    EXPECT_EQ(registry.enumerateBuilders(visitor), Ov::RnEnum::goOn);
    EXPECT_EQ(names,
              (std::set<std::wstring>{L"CIBSE Web", L"Diffuse Distribution", L"IES Web", L"Isotropic Distribution",
                                      L"LID Importer", L"NIMB Web", L"Natural Lighting", L"Spotlight Distribution",
                                      L"TBT Web", L"Web Distribution"}));
    EXPECT_EQ(registry.getBuilderCount(), names.size());
    const auto imports = [](const Ov::RnUid& id) {
        return id == ids::cibseWeb || id == ids::iesWeb || id == ids::nimbWeb || id == ids::tbtWeb;
    };
    for (Ov::RnUid id : {ids::cibseWeb, ids::diffuse, ids::iesWeb, ids::importer, ids::isotropic,
                         ids::naturalLight, ids::nimbWeb, ids::spotlight, ids::tbtWeb, ids::webDistribution}) {
        const auto builder = registry.getBuilder(id);
        ASSERT_TRUE(builder);
        EXPECT_TRUE(builder->hasInterface(Ov::RnBuilderDescription::iid));
        EXPECT_EQ(builder->hasInterface(Ov::RnImportBuilder::iid), imports(id));
        EXPECT_EQ(builder->isCreatable(), id != ids::importer);
        EXPECT_TRUE(builder->create());
        for (std::uint32_t* word : {&id.w0, &id.w1, &id.w2, &id.w3}) {
            ++*word;
            EXPECT_FALSE(registry.getBuilder(id));
            --*word;
        }
    }
    int seen = 0;
    auto stopping = Ov::rnVisitor<Ov::RnPtr<Ov::RnComponentBuilder>>([&](Ov::RnPtr<Ov::RnComponentBuilder>) {
        ++seen;
        return Ov::RnEnum::stop;
    });
    EXPECT_EQ(registry.enumerateBuilders(stopping), Ov::RnEnum::stop);
    EXPECT_EQ(seen, 1);
}

TEST_F(ModuleTest, NumberedExportsAnswerByTheirOrdinals) {
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
    EXPECT_STREQ(OvPhotometrics::numberedFunctions(*module).getMonthShortName(5), L"May");
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
