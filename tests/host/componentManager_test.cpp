#include "host/componentManager/componentManager.h"

#include <dlfcn.h>
#include <gmock/gmock.h>

#include "host/componentManager/devices.h"
#include "host/componentManager/importer.h"
#include "host/componentManager/streamEx.h"
#include "host/platform/module.h"
#include "host/platform/path.h"
#include "support/tempFolder.h"
#include "testBuilders.h"

namespace Ov {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;

constexpr RnUid id(std::uint32_t w0) { return {w0, 0xa, 0xb, 0xc}; }

RnRef<RnComponentManager> manager() { return rnCast<RnComponentManager>(RnGetComponentManager()); }

std::vector<std::wstring> names(const std::vector<RnRef<RnComponentBuilder>>& builders) {
    std::vector<std::wstring> all;
    for (const auto& builder : builders) all.push_back(builder->getName());
    return all;
}

/// A register with importers "Apple" and "Pear" (both take "fruit"), "Nut", and two builders that import nothing.
class ComponentManager : public testing::Test {
protected:
    ComponentManager() {
        manager()->addRegistry(first);
        manager()->addRegistry(second);
    }
    ~ComponentManager() override {
        manager()->removeRegistry(first);
        manager()->removeRegistry(second);
    }

    ThingImportBuilder pear{id(1), L"Pear", "fruit", {L"pr", L"frt"}};
    ThingImportBuilder nut{id(2), L"Nut", "nut", {L"nut"}};
    ThingImportBuilder apple{id(3), L"Apple", "fruit", {L"frt"}};
    ThingBuilder stone{id(4), L"Thing", L"Basalt"};
    ThingBuilder cloud{id(5), L"Air", L"Zephyr"};
    ThingBuilder impostor{id(2), L"Thing", L"Impostor"};
    ThingRegistry first{{&pear, &stone, &nut}};
    ThingRegistry second{{&impostor, &cloud, &apple}};
    TempFolder folder;
};

TEST_F(ComponentManager, ClassesAreFoundByTheirWholeId) {
    EXPECT_EQ(manager()->findBuilder(id(5)).get(), &cloud);
    for (const RnUid& wrong :
         {RnUid{6, 0xa, 0xb, 0xc}, RnUid{5, 0, 0xb, 0xc}, RnUid{5, 0xa, 0, 0xc}, RnUid{5, 0xa, 0xb, 0}}) {
        EXPECT_FALSE(manager()->findBuilder(wrong));
        EXPECT_FALSE(manager()->createObject(wrong));
    }
    const RnRef<RnCastable> object = manager()->createObject(id(5));
    EXPECT_EQ(rnCast<Thing>(object.get())->classId, id(5));
}

TEST_F(ComponentManager, BuildersComeByCategoryAndName) {
    EXPECT_THAT(names(manager()->builders()), ElementsAre(L"Zephyr", L"Apple", L"Basalt", L"Nut", L"Pear"));
    EXPECT_THAT(names(manager()->builders(L"Thing")), ElementsAre(L"Apple", L"Basalt", L"Nut", L"Pear"));
    EXPECT_THAT(names(manager()->builders(L"thing")), ElementsAre());
}

TEST_F(ComponentManager, TheFirstOfAClassCounts) {
    EXPECT_EQ(manager()->findBuilder(id(2)).get(), static_cast<RnComponentBuilder*>(&nut));
    manager()->addRegistry(first);  // counts once
    manager()->removeRegistry(first);
    EXPECT_EQ(manager()->findBuilder(id(2)).get(), &impostor);
    EXPECT_THAT(names(manager()->builders()), ElementsAre(L"Zephyr", L"Apple", L"Impostor"));
    EXPECT_FALSE(manager()->createObject(id(1)));
}

TEST_F(ComponentManager, ImportersAreFoundByContent) {
    const auto fruit = rnCreate<RnMemoryBuffer>("..fruit"), nothing = rnCreate<RnMemoryBuffer>("");
    fruit->seek(2, 0);
    EXPECT_THAT(names(manager()->importersFor(L"Thing", fruit.get())), ElementsAre(L"Apple", L"Pear"));
    EXPECT_EQ(fruit->seek(0, 1), 2);
    EXPECT_THAT(names(manager()->importersFor(L"Thing", nothing.get())), ElementsAre());
    EXPECT_THAT(names(manager()->importersFor(L"Air", fruit.get())), ElementsAre());
}

/// What an import leaves in the object: name, folder and content.
std::vector<std::wstring> facts(const RnRef<RnCastable>& object) {
    const auto thing = rnCast<Thing>(object.get());
    return {thing->name, thing->basePath, fromUtf8(thing->firstBytes)};
}

TEST_F(ComponentManager, FilesAreImportedUnderTheirNames) {
    const std::wstring path = folder.write("wall.v2.nut", "nut and bolt");
    EXPECT_TRUE(nut.canImport(path.c_str(), nullptr));
    EXPECT_FALSE(pear.canImport(path.c_str(), nullptr));
    EXPECT_THAT(facts(nut.import(path.c_str(), nullptr)), ElementsAre(L"wall.v2", folder.wide(), L"nut"));
    EXPECT_THAT(facts(nut.import(path.c_str(), L"")), ElementsAre(L"wall.v2", folder.wide(), L"nut"));
    EXPECT_THAT(facts(nut.import(path.c_str(), L"/b")), ElementsAre(L"wall.v2", L"/b", L"nut"));
}

class TestImporter : public RnCastHeap<RnCastImpl<RnBaseImporter, RnImporter>> {
public:
    const wchar_t* getImportCategory() const override { return category; }
    const wchar_t* category = L"Thing";
};

TEST_F(ComponentManager, AFileThatCannotBeOpenedIsNamed) {
    const auto importer = rnCreate<TestImporter>();
    bool recognised = true;
    for (const auto& [path, reason] : {std::pair{folder.wide("absent.nut"), "no such file"},
                                       std::pair{folder.wide(), "folder"}, std::pair{std::wstring(), "no such"}}) {
        EXPECT_FALSE(nut.canImport(path.c_str(), nullptr));
        try {
            nut.import(path.c_str(), nullptr);
            ADD_FAILURE();
        } catch (const RnStreamEx::ExReadError& e) {
            EXPECT_THAT(e.what(), testing::AllOf(HasSubstr(toUtf8(path)), HasSubstr(reason)));
            EXPECT_STREQ(e.getFile(), "host/componentManager/builder");
        }
        EXPECT_THROW(importer->import(path.c_str(), nullptr, recognised), RnStreamEx::ExReadError);
        EXPECT_FALSE(recognised);
    }
}

TEST_F(ComponentManager, TheImporterOffersItsFamily) {
    const auto importer = rnCreate<TestImporter>();
    EXPECT_STREQ(importer->getFileTypes(),
                 L"All (*.frt;*.nut;*.pr)|*.frt;*.nut;*.pr|Apple (*.frt)|*.frt|Nut (*.nut)|*.nut|"
                 L"Pear (*.pr;*.frt)|*.pr;*.frt");
    EXPECT_STREQ(importer->getDefaultSearch(), L"*.frt;*.nut;*.pr");
    importer->category = L"Air";
    EXPECT_STREQ(importer->getFileTypes(), L"");
    EXPECT_STREQ(importer->getDefaultSearch(), L"");
}

struct Walk : RnEnumerator<RnCPtr<RnImportBuilder>> {
    explicit Walk(std::size_t stopAfter) : limit(stopAfter) {}
    RnEnum::Action visit(RnCPtr<RnImportBuilder> builder) override {
        visited.push_back(builder.get());
        return visited.size() < limit ? RnEnum::goOn : RnEnum::stop;
    }
    RnEnum::Action finish() override {
        finished = true;
        return RnEnum::stop;
    }
    std::size_t limit;
    std::vector<const RnImportBuilder*> visited;
    bool finished = false;
};

TEST_F(ComponentManager, TheImporterVisitsItsBuildersByName) {
    const auto importer = rnCreate<TestImporter>();
    Walk all(10), two(2);
    EXPECT_EQ(importer->enumerateObjects(all), RnEnum::stop) << "what finish answers";
    EXPECT_THAT(all.visited, ElementsAre(&apple, &nut, &pear));
    EXPECT_TRUE(all.finished);
    EXPECT_EQ(importer->enumerateObjects(two), RnEnum::stop);
    EXPECT_THAT(two.visited, ElementsAre(&apple, &nut));
    EXPECT_FALSE(two.finished);
}

TEST_F(ComponentManager, TheImporterTakesTheFirstThatAccepts) {
    const auto importer = rnCreate<TestImporter>();
    const std::wstring fruit = folder.write("a.nut", "fruit"), other = folder.write("b.nut", "other");
    bool recognised = false;
    const RnRef<RnCastable> object = importer->import(fruit.c_str(), nullptr, recognised);
    EXPECT_TRUE(recognised);
    EXPECT_EQ(rnCast<Thing>(object.get())->classId, apple.classId);
    EXPECT_THAT(facts(object), ElementsAre(L"a", folder.wide(), L"fruit"));
    EXPECT_THAT(facts(importer->import(fruit.c_str(), L"/b")), ElementsAre(L"a", L"/b", L"fruit"));

    EXPECT_FALSE(importer->import(other.c_str(), nullptr, recognised));
    EXPECT_FALSE(recognised);

    const auto nuts = rnCreate<RnMemoryBuffer>("nut"), others = rnCreate<RnMemoryBuffer>("other");
    EXPECT_THAT(facts(importer->import(nuts.get(), L"name", L"/c")), ElementsAre(L"name", L"/c", L"nut"));
    EXPECT_FALSE(importer->import(others.get(), L"name", L"/c"));
}

const std::string moduleFile = OVPHOTO_BIN_DIR "/libhostTestModule.so";
const std::string emptyModuleFile = OVPHOTO_BIN_DIR "/libhostEmptyModule.so";

bool isLoaded(const std::string& file) {
    void* handle = dlopen(file.c_str(), RTLD_NOW | RTLD_NOLOAD);
    if (handle) dlclose(handle);
    return handle != nullptr;
}

TEST(Module, IsLoadedOnceAndUnloaded) {
    constexpr RnUid classId{7, 7, 7, 7};
    const TempFolder folder;
    std::filesystem::create_symlink(moduleFile, folder.path() / "link.so");
    const std::wstring path = fromUtf8(moduleFile);

    const ::Ov::Module& module = manager()->loadModule(path.c_str());
    EXPECT_EQ(module.path(), path);
    EXPECT_EQ(&manager()->loadModule(path.c_str()), &module);
    EXPECT_EQ(&manager()->loadModule(folder.wide("link.so").c_str()), &module);
    EXPECT_TRUE(rnQuery<Thing>(manager()->createObject(classId).get()));
    EXPECT_THAT(names(manager()->builders(L"Module Thing")), ElementsAre(L"From a module"));

    manager()->unloadModule(L"/elsewhere.so");
    EXPECT_TRUE(manager()->findBuilder(classId));
    manager()->unloadModule(folder.wide("link.so").c_str());
    EXPECT_FALSE(manager()->findBuilder(classId));
    EXPECT_FALSE(isLoaded(moduleFile));
}

TEST(Module, WhatCannotBeLoadedIsNamedAndNotKept) {
    const TempFolder folder;
    const std::wstring emptyModule = fromUtf8(emptyModuleFile);
    const struct {
        std::wstring path;
        const char* reason;
    } cases[] = {
        {folder.wide("l\xC3\xA4mp.so"), "no such file"},
        {folder.write("text\xE9.so", "text"), "file too short"},
        {folder.wide(), "folder"},
        {L"libm.so.6", "no such file"},
        {L"", "no such file"},
        {emptyModule, "RnGetComponentDescription"},
    };
    for (const auto& c : cases) {
        try {
            manager()->loadModule(c.path.c_str());
            ADD_FAILURE() << toUtf8(c.path);
        } catch (const ExModule& e) {
            EXPECT_THAT(e.what(), testing::AllOf(HasSubstr(toUtf8(c.path)), HasSubstr(c.reason)));
            EXPECT_STREQ(e.getReason(), e.what());
        }
    }
    EXPECT_FALSE(isLoaded(emptyModuleFile));
    EXPECT_THAT(manager()->builders(), ElementsAre());
}

TEST(Module, NumberedExportsAreFound) {
    const ::Ov::Module module(fromUtf8(moduleFile));
    EXPECT_EQ(module.byOrdinal<int(int)>(422)(5), 10);
    EXPECT_EQ(module.byOrdinal<int(int)>(431)(5), 15);
    for (const std::uint32_t ordinal : {0u, 1u, 423u, 432u}) EXPECT_EQ(module.byOrdinal(ordinal), nullptr);
    EXPECT_NE(module.byName("RnGetComponentDescription"), nullptr);
    EXPECT_EQ(module.byName("twice"), nullptr);

    const ::Ov::Module without(fromUtf8(emptyModuleFile));
    EXPECT_EQ(without.byOrdinal(422), nullptr);
    EXPECT_EQ(without.byOrdinal(0), nullptr);
}

}  // namespace
}  // namespace Ov
