#include "host/componentManager/castImpl.h"

#include <gmock/gmock.h>

#include <stdexcept>
#include <thread>

#include "host/componentManager/postLoadList.h"
#include "testObjects.h"

namespace Ov {
namespace {

using testing::ElementsAre;

constexpr RnUid unknown{0x11, 2, 3, 5};

/// The count that a further holder finds: holders minus one.
long countOf(const RnCastable& object) {
    object.newReference();
    return object.release();
}

TEST(CastImpl, CountedObjectsAnswerTheirInterfacesAndEndWithTheirLastHolder) {
    const int before = NoteData::alive;
    auto note = rnCreate<Note>();
    EXPECT_EQ(countOf(*note), 0);
    EXPECT_FALSE(note->hasInterface(unknown));
    EXPECT_EQ(note->getInterface(unknown), nullptr);
    EXPECT_EQ(countOf(*note), 0);

    EXPECT_TRUE(note->hasInterface(NoteData::iid));
    RnCastable* found = note->getInterface(NoteData::iid);
    EXPECT_EQ(found, note.get());
    EXPECT_EQ(countOf(*note), 1);
    EXPECT_EQ(found->release(), 0);
    EXPECT_EQ(NoteData::alive, before + 1);
    EXPECT_EQ(note.detach()->release(), -1);
    EXPECT_EQ(NoteData::alive, before);
}

TEST(CastImpl, CopiesHaveTheirOwnHolders) {
    const auto note = rnCreate<Note>();
    const RnRef<Note> second = note;
    const auto copy = rnCreate<Note>(*note);
    EXPECT_EQ(countOf(*copy), 0);
    EXPECT_EQ(countOf(*note), 1);
}

TEST(CastImpl, AdaptersAreNewEachTimeAndHoldTheirData) {
    const int before = NoteData::alive;
    auto note = rnCreate<Note>();
    EXPECT_TRUE(note->hasInterface(RnPersistant::iid));
    auto first = rnCast<RnPersistant>(note.get());
    auto second = rnCast<RnPersistant>(note.get());
    EXPECT_NE(first.get(), second.get());
    EXPECT_EQ(first->getClassId(), Note::classId);
    EXPECT_EQ(countOf(*first), 0);
    EXPECT_EQ(countOf(*note), 2);
    EXPECT_EQ(first->getInterface(NoteData::iid), nullptr);

    note = {};
    second = {};
    EXPECT_EQ(NoteData::alive, before + 1);
    first = {};
    EXPECT_EQ(NoteData::alive, before);
}

TEST(CastImpl, ASecondBaseAnswersWithItsOwnPart) {
    ThingImportBuilder builder({7}, L"Import", "", {});
    RnImportBuilder* part = &builder;
    EXPECT_EQ(builder.getInterface(RnImportBuilder::iid), part);
    EXPECT_EQ(part->getInterface(RnImportBuilder::iid), part);
    RnComponentBuilder* whole = &builder;
    EXPECT_EQ(part->getInterface(RnComponentBuilder::iid), whole);
    EXPECT_EQ(part->getInterface(RnBuilderDescription::iid), whole);
    EXPECT_EQ(part->getCastable(), whole->getCastable());
    EXPECT_TRUE(part->hasInterface(RnBuilderDescription::iid));
    EXPECT_FALSE(part->hasInterface(RnPersistant::iid));
    EXPECT_EQ(rnCast<RnImportBuilder>(whole).get(), part);
    // A static object: as many releases as one likes.
    for (int i = 0; i < 3; ++i) EXPECT_EQ(part->release(), 0);
}

TEST(CastImpl, ReferencesAreCountedAcrossThreads) {
    const auto note = rnCreate<Note>();
    const auto work = [&note] {
        for (int i = 0; i < 20000; ++i) const RnRef<RnCastable> holder = note;
    };
    std::thread first(work), second(work);
    first.join();
    second.join();
    EXPECT_EQ(countOf(*note), 0);
}

TEST(CastImpl, CastsThrowOrAskTheTranslators) {
    EXPECT_THROW(rnCast<NoteData>(nullptr), ExBadCast);
    EXPECT_FALSE(rnQuery<NoteData>(nullptr));
    const auto box = rnCreate<Box>();
    EXPECT_THROW(rnCast<NoteData>(box.get()), std::bad_cast);

    // A translator that shows a box as a new note.
    const RnTranslator translator = [](RnCastable* object, const RnUid& iid) -> RnCastable* {
        if (!object->hasInterface(BoxData::iid) || !(iid == NoteData::iid)) return nullptr;
        return rnCreate<Note>().detach();
    };
    const int before = NoteData::alive;
    RnAddTranslator(translator);
    EXPECT_EQ(countOf(*rnCast<NoteData>(box.get())), 0);
    EXPECT_THROW(rnCast<RnBufferedIO>(box.get()), ExBase);
    RnRemoveTranslator(translator);
    EXPECT_FALSE(rnQuery<NoteData>(box.get()));
    EXPECT_EQ(NoteData::alive, before);
}

// The post-load list.

class Listed : public RnPersistant {
public:
    explicit Listed(std::function<void()> finished) : _finished(std::move(finished)) {}
    const RnUid& getClassId() const override { return iid; }
    int getVersion() const override { return 1; }
    void save(RnStream&) override {}
    bool load(RnStream&, int, const wchar_t*, const wchar_t*) override { return true; }
    void loadFinished() override { _finished(); }

private:
    std::function<void()> _finished;
};
using ListedObject = RnCastHeap<RnCastImpl<Listed, RnPersistant>>;

class PostLoadList : public testing::Test {
protected:
    RnRef<ListedObject> object(int number) {
        return rnCreate<ListedObject>([this, number] { finished.push_back(number); });
    }
    std::vector<int> finished;
};

TEST_F(PostLoadList, CallsInOrderOnceAndLetsGo) {
    const auto first = object(1);
    RnRef<ListedObject> late = object(4);
    {
        RnPostLoadList list, other;
        const auto adds = rnCreate<ListedObject>([&] { list.add(*late); });
        list.add(*first);
        list.add(*adds);
        other.add(*object(2));
        other.add(*object(3));
        list.take(other);
        EXPECT_TRUE(other.empty());
        list.take(list);
        EXPECT_EQ(countOf(*first), 1);
    }
    EXPECT_THAT(finished, ElementsAre(1, 2, 3, 4));
    EXPECT_EQ(countOf(*first), 0);
    EXPECT_EQ(countOf(*late), 0);
}

TEST_F(PostLoadList, AnExceptionLetsTheRestGoUncalled) {
    const auto last = object(3);
    const auto fails = rnCreate<ListedObject>([] { throw std::runtime_error("refused"); });
    RnPostLoadList list;
    list.add(*object(1));
    list.add(*fails);
    list.add(*last);
    EXPECT_THROW(list.finish(), std::runtime_error);
    EXPECT_TRUE(list.empty());
    EXPECT_EQ(countOf(*last), 0);
    EXPECT_EQ(countOf(*fails), 0);
    EXPECT_THAT(finished, ElementsAre(1));

    // The end of a list has nobody to tell.
    {
        RnPostLoadList ending;
        ending.add(*fails);
        ending.add(*last);
    }
    EXPECT_EQ(countOf(*last), 0);
    list.add(*last);
    list.finish();
    EXPECT_THAT(finished, ElementsAre(1, 3));
}

}  // namespace
}  // namespace Ov
