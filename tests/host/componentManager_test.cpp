#include "host/componentManager/componentManager.h"

#include <gmock/gmock.h>

#include "host/componentManager/importer.h"
#include "host/componentManager/module.h"
#include "ovphoto/classIds.h"
#include "support/paths.h"
#include "support/tempFolder.h"
#include "testObjects.h"

using namespace Ov;
using namespace std::string_literals;
using testing::ElementsAre;
using testing::HasSubstr;

/// The count that a further holder finds: holders minus one.
long countOf(const RnCastable& object) {
    object.newReference();
    return object.release();
}

TEST(CastImpl, CountedObjectsEndWithTheirLastHolder) {
    auto data = note(L"");
    EXPECT_FALSE(data->hasInterface({0x11, 2, 3, 5}) || data->getInterface({0x11, 2, 3, 5}));
    EXPECT_TRUE(data->hasInterface(NoteData::iid));
    RnCastable* found = data->getInterface(NoteData::iid);
    EXPECT_EQ(found, data.get());
    EXPECT_EQ(countOf(*data), 1);
    EXPECT_EQ(countOf(*rnCreate<Note>(*data)), 0);  // a copy has its own holders
    EXPECT_EQ(found->release(), 0);
    EXPECT_EQ(NoteData::alive(), 1);
    EXPECT_EQ(data.detach()->release(), -1);
    EXPECT_EQ(NoteData::alive(), 0);
}

TEST(CastImpl, AdaptersAreNewEachTimeAndHoldTheirData) {
    auto data = note(L"");
    EXPECT_TRUE(data->hasInterface(RnPersistant::iid));
    auto first = rnCast<RnPersistant>(data.get()), second = rnCast<RnPersistant>(data.get());
    EXPECT_NE(first.get(), second.get());
    EXPECT_EQ(countOf(*first), 0);
    EXPECT_EQ(countOf(*data), 2);
    EXPECT_EQ(first->getInterface(NoteData::iid), nullptr);
    data = {};
    second = {};
    EXPECT_EQ(NoteData::alive(), 1);
    first = {};
    EXPECT_EQ(NoteData::alive(), 0);
}

TEST(CastImpl, ASecondBaseAnswersWithItsOwnPart) {
    ThingImportBuilder builder({7}, L"Import", "", {});
    RnImportBuilder* part = &builder;
    RnComponentBuilder* whole = &builder;
    EXPECT_EQ(whole->getInterface(RnImportBuilder::iid), part);
    EXPECT_EQ(part->getInterface(RnBuilderDescription::iid), whole);
    EXPECT_EQ(part->getCastable(), whole->getCastable());
    EXPECT_TRUE(part->hasInterface(RnBuilderDescription::iid) && whole->hasInterface(RnImportBuilder::iid));
    EXPECT_FALSE(part->hasInterface(RnPersistant::iid));
    // A static object: as many releases as one likes.
    for (int i = 0; i < 3; ++i) EXPECT_EQ(part->release(), 0);
}

TEST(CastImpl, CastsThrowOrAskTheTranslators) {
    const auto thing = rnCreate<ThingObject>();
    EXPECT_THROW(rnCast<NoteData>(nullptr), ExBadCast);
    EXPECT_FALSE(rnQuery<NoteData>(nullptr));
    const RnTranslator toNewNote = [](RnCastable*, const RnUid& iid) -> RnCastable* {
        return iid == NoteData::iid ? note(L"").detach() : nullptr;
    };
    RnAddTranslator(toNewNote);
    EXPECT_EQ(countOf(*rnCast<NoteData>(thing.get())), 0);
    EXPECT_THROW(rnCast<RnBufferedIO>(thing.get()), ExBase);
    RnRemoveTranslator(toNewNote);
    EXPECT_THROW(rnCast<NoteData>(thing.get()), std::bad_cast);
    EXPECT_EQ(NoteData::alive(), 0);
}

TEST(PostLoadList, CallsInOrderOnceAndLetsGoEvenWhenOneThrows) {
    const RnRef<Note> notes[] = {note(L"a"), note(L"b adds"), note(L"c"), note(L"d fails"), note(L"e")};
    std::wstring finished;
    {
        RnPostLoadList list, other, ending;
        const auto add = [&](RnPostLoadList& to, int i) { to.add(*rnCast<RnPersistant>(notes[i].get())); };
        NoteData::whenFinished = [&](const std::wstring& text) {
            finished += text[0];
            if (text == L"b adds") add(list, 3), add(list, 4);
            if (text == L"d fails") throw std::runtime_error("refused");
        };
        add(list, 0), add(list, 1), add(other, 2);
        list.take(other);
        list.take(list);
        EXPECT_EQ(countOf(*notes[0]), 1);
        EXPECT_THROW(list.finish(), std::runtime_error);
        EXPECT_TRUE(list.empty() && other.empty());
        add(list, 4), add(ending, 3);  // the end has nobody to tell
    }
    for (const auto& each : notes) EXPECT_EQ(countOf(*each), 0);
    EXPECT_EQ(finished, L"abcdde");
}

Facts names(const std::vector<RnRef<RnComponentBuilder>>& builders) {
    Facts all;
    for (const auto& builder : builders) all.push_back(builder->getName());
    return all;
}

Facts facts(const RnRef<RnCastable>& object) { return rnCast<Thing>(object.get())->facts; }

class TestImporter : public RnCastHeap<RnCastImpl<RnBaseImporter, RnImporter>> {
public:
    const wchar_t* getImportCategory() const override { return L"Thing"; }
};

/// A register with importers "Apple" and "Pear" (both take "fruit"), "Nut", and builders that import nothing.
class ComponentManager : public testing::Test {
protected:
    ComponentManager() {
        for (ThingRegistry* each : {&first, &second}) manager->addRegistry(*each);
    }
    ~ComponentManager() override {
        for (ThingRegistry* each : {&first, &second}) manager->removeRegistry(*each);
    }

    RnRef<RnComponentManager> manager = rnCast<RnComponentManager>(RnGetComponentManager());
    ThingImportBuilder pear{{1, 7, 8, 9}, L"Pear", "fruit", {L"pr", L"frt"}};
    ThingImportBuilder nut{{2, 7, 8, 9}, L"Nut", "nut", {L"nut"}};
    ThingImportBuilder apple{{3, 7, 8, 9}, L"Apple", "fruit", {L"frt"}};
    ThingBuilder stone{{4, 7, 8, 9}, L"Thing", L"Basalt"}, cloud{{5, 7, 8, 9}, L"Air", L"Zephyr"};
    ThingBuilder impostor{{2, 7, 8, 9}, L"Thing", L"Impostor"};
    ThingRegistry first{{&pear, &stone, &nut}}, second{{&impostor, &cloud, &apple}};
    RnRef<TestImporter> importer = rnCreate<TestImporter>();
    TempFolder folder;
};

TEST_F(ComponentManager, FindsTheFirstOfAClassByItsWholeId) {
    for (const RnUid& wrong : {RnUid{6, 7, 8, 9}, RnUid{5, 0, 8, 9}, RnUid{5, 7, 0, 9}, RnUid{5, 7, 8, 0}})
        EXPECT_FALSE(manager->findBuilder(wrong) || manager->createObject(wrong));
    EXPECT_THAT(facts(manager->createObject({5, 7, 8, 9})), ElementsAre(L"Zephyr"));
    EXPECT_THAT(facts(manager->createObject({2, 7, 8, 9})), ElementsAre(L"Nut"));
    EXPECT_THAT(names(manager->builders()), ElementsAre(L"Zephyr", L"Apple", L"Basalt", L"Nut", L"Pear"));
    EXPECT_THAT(names(manager->builders(L"Thing")), ElementsAre(L"Apple", L"Basalt", L"Nut", L"Pear"));
    manager->addRegistry(first);  // counts once
    manager->removeRegistry(first);
    EXPECT_THAT(names(manager->builders()), ElementsAre(L"Zephyr", L"Apple", L"Impostor"));
}

TEST_F(ComponentManager, ImportsFilesByContentUnderTheirNames) {
    const std::wstring path = folder.write("wall.v2.nut", "nut and bolt"), fruit = folder.write("a.nut", "fruit");
    EXPECT_TRUE(nut.canImport(path.c_str(), nullptr));
    EXPECT_FALSE(pear.canImport(path.c_str(), nullptr));
    for (const wchar_t* base : {static_cast<const wchar_t*>(nullptr), L"", L"/b"}) {
        const std::wstring where = base && *base ? base : folder.wide();
        EXPECT_THAT(facts(nut.import(path.c_str(), base)),
                    ElementsAre(L"Nut", L"wall.v2", where, L"nut and bolt"));
        EXPECT_THAT(facts(importer->import(fruit.c_str(), base)), ElementsAre(L"Apple", L"a", where, L"fruit"));
    }
    EXPECT_STREQ(importer->getDefaultSearch(), L"*.frt;*.nut;*.pr");
    EXPECT_STREQ(importer->getFileTypes(),
                 L"All (*.frt;*.nut;*.pr)|*.frt;*.nut;*.pr|Apple (*.frt)|*.frt|Nut (*.nut)|*.nut|"
                 L"Pear (*.pr;*.frt)|*.pr;*.frt");
    bool recognised = true;
    EXPECT_FALSE(importer->import(folder.write("b.nut", "other").c_str(), nullptr, recognised));
    EXPECT_FALSE(recognised);
    EXPECT_TRUE(importer->import(path.c_str(), nullptr, recognised) && recognised);

    const auto device = rnCreate<RnMemoryBuffer>("..fruit");
    EXPECT_FALSE(importer->import(device.get(), L"name", L"/c"));
    device->seek(2, 0);
    EXPECT_THAT(facts(importer->import(device.get(), L"name", L"/c")),
                ElementsAre(L"Apple", L"name", L"/c", L"fruit"));
}

template <class Exception, class F>
std::string failureOf(F function) {
    try {
        function();
    } catch (const Exception& e) {
        return dynamic_cast<const ExBase&>(e).getDetailedReason();
    }
    return "nothing raised";
}

TEST_F(ComponentManager, NamesWhatCannotBeOpenedOrLoaded) {
    const std::wstring text = folder.write("text\u00E9.so", "text"), host = fromUtf8(hostPath());
    for (const auto& path : {folder.wide("l\xC3\xA4mp.so"), folder.wide(), L"libm.so.6"s}) {
        const std::string reason = path == folder.wide() ? ": it is a folder" : ": no such file";
        bool recognised = true;
        EXPECT_FALSE(nut.canImport(path.c_str(), nullptr));
        EXPECT_THAT(failureOf<std::runtime_error>([&] { nut.import(path.c_str(), nullptr); }),
                    HasSubstr(toUtf8(path) + reason + " (host/componentManager/builder, line "));
        EXPECT_THROW(importer->import(path.c_str(), nullptr, recognised), RnStreamEx::ExReadError);
        EXPECT_FALSE(recognised);
        EXPECT_THAT(failureOf<ExModule>([&] { manager->loadModule(path.c_str()); }),
                    HasSubstr(toUtf8(path) + reason));
    }
    EXPECT_THAT(failureOf<ExModule>([&] { manager->loadModule(text.c_str()); }),
                AllOf(HasSubstr("\u00E9.so: "), Not(HasSubstr("no such file"))));
    EXPECT_THAT(failureOf<ExModule>([&] { manager->loadModule(host.c_str()); }),
                HasSubstr("RnGetComponentDescription"));
    EXPECT_THROW(manager->loadModule(nullptr), ExModule);
    manager->unloadModule(nullptr);
    EXPECT_EQ(manager->builders().size(), 5U);
}

TEST_F(ComponentManager, LoadsAModuleOnceAndUnloadsIt) {
    const std::wstring path = fromUtf8(modulePath()),
                       link = pathFolder(path) + L"/de/.." + path.substr(path.find_last_of(L"/\\"));
    const Module& module = manager->loadModule(path.c_str());
    EXPECT_EQ(&manager->loadModule(link.c_str()), &module);
    EXPECT_EQ(Module(fromUtf8(hostPath())).byOrdinal(422), nullptr);
    manager->unloadModule(L"/elsewhere.so");
    EXPECT_TRUE(manager->createObject(OvPhotometrics::classIds::iesWeb));
    manager->unloadModule(link.c_str());
    EXPECT_FALSE(manager->findBuilder(OvPhotometrics::classIds::iesWeb));
    EXPECT_FALSE(isLoaded(modulePath()));
}
