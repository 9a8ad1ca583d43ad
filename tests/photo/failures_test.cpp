#include <cstdlib>
#include <functional>
#include <new>

#include "components/messageFile/messageIds.h"
#include "components/photo/cibse/photoWebCIBSE.h"
#include "components/photo/distributions/diffuse.h"
#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/spotlight.h"
#include "components/photo/lid/importer.h"
#include "components/photo/lid/reportMessage.h"
#include "components/photo/naturallight/daylightData.h"
#include "components/photo/nimb/photoWebNIMB.h"
#include "components/photo/tbt/photoWebTBT.h"
#include "tests/photo/photoFixture.h"
#include "tests/support/dripDevice.h"

// What a host asks of every class, while an allocation, all memory or a device fails, at every place in turn.

namespace {

enum class Fault { oneAllocation, allMemory, device };

/// Fails at one place: `left` is how many others are passed before it, negative when there is none.
struct Trap {
    Fault fault = Fault::device;
    long left = -1;
    bool sprung = false;

    bool springs(Fault here) {
        if (left < 0 || here != fault || left-- > 0) return false;
        if (fault != Fault::oneAllocation) left = 0;  // and for good
        return sprung = true;
    }
} trap;

long blocks = 0;  // that are allocated

void* allocate(std::size_t size) {
    if (trap.springs(Fault::oneAllocation) || trap.springs(Fault::allMemory)) throw std::bad_alloc();
    void* const block = std::malloc(size > 0 ? size : 1);
    if (!block) throw std::bad_alloc();
    ++blocks;
    return block;
}

void release(void* block) {
    if (block) --blocks;
    std::free(block);
}

}  // namespace

#include "tests/support/replacedHeap.h"

namespace OvPhotometrics {
namespace {

struct DeviceFailure {};

/// Memory that is read byte by byte, and may fail at every read and write.
class FailingDevice : public DripDevice {
public:
    explicit FailingDevice(const std::string& bytes = {}) : DripDevice(bytes) {}

protected:
    bool readMore() override {
        if (trap.springs(Fault::device)) throw DeviceFailure();
        return DripDevice::readMore();
    }
    char* prepareWrite(std::size_t count) override {
        if (trap.springs(Fault::device)) throw DeviceFailure();
        return DripDevice::prepareWrite(count);
    }
};

class Failures : public Photo {
protected:
    Failures() {
        // What is kept for the next time is there.
        Ov::RnPostLoadList().add(*Ov::rnCast<Ov::RnPersistant>(Ov::rnCreate<Isotropic>().get()));
        reportMessage(messages::outOfMemory);
        log.take();
    }

    enum class Outcome { well, refused, noMemory, brokenDevice };

    template <class Work>
    static Outcome outcomeOf(const Work& work) {
        try {
            return work() ? Outcome::well : Outcome::refused;
        } catch (const Ov::RnStreamEx&) {
            return Outcome::refused;
        } catch (const std::bad_alloc&) {
            return Outcome::noMemory;
        } catch (const Ov::ExBadCast&) {
            return Outcome::noMemory;  // there is no distribution to save by
        } catch (const DeviceFailure&) {
            return Outcome::brokenDevice;
        }
    }

    /// Lets `work` fail at every place in turn, until it goes well. Each time it says so, nothing is left behind,
    /// and `object` is as it was. With `tells`, one allocation that fails is told of and raises nothing.
    template <class Work>
    void atEveryPlace(const std::string& what, Ov::RnCastable& object, const Work& work, bool tells = false) {
        const std::string original = saved(object, Form::binary);
        for (const Fault fault : {Fault::oneAllocation, Fault::allMemory, Fault::device}) {
            load(object, original, Form::binary);
            const std::string before = saved(object, Form::binary);
            // Every place of what is small; ever fewer of the thousands of numbers that some formats write.
            for (long place = 0; !HasFailure(); place += 1 + (place > 200 ? place / 10 : 0)) {
                SCOPED_TRACE(what + ", fault " + std::to_string(static_cast<int>(fault)) + ", place " +
                             std::to_string(place));
                if (!failsAt({fault, place}, tells && fault == Fault::oneAllocation, work)) break;
                EXPECT_EQ(saved(object, Form::binary), before);
            }
        }
    }

    /// False when `work` goes well without coming to the place.
    template <class Work>
    bool failsAt(Trap place, bool tells, const Work& work) {
        const long blocksBefore = blocks;
        trap = place;
        const Outcome outcome = outcomeOf(work);
        const bool sprung = std::exchange(trap, {}).sprung;
        const bool isTold = !log.take().empty();
        const long blocksLeft = blocks - blocksBefore;
        EXPECT_EQ(outcome != Outcome::well, sprung);
        EXPECT_TRUE(outcome != Outcome::refused || isTold);
        EXPECT_TRUE(!tells || outcome != Outcome::noMemory);
        EXPECT_EQ(outcome == Outcome::brokenDevice, sprung && place.fault == Fault::device);
        EXPECT_TRUE(!sprung || blocksLeft == 0 || !heapIsShared) << blocksLeft << " blocks are left";
        return sprung;
    }

    /// What is made while nothing fails.
    template <class Make>
    static auto spared(const Make& make) {
        const Trap set = std::exchange(trap, {});
        auto made = make();
        trap = set;
        return made;
    }

    static std::unique_ptr<Ov::RnStream> textStream(Ov::RnBufferedIO& io) {
        return spared([&] { return std::make_unique<Ov::RnStream>(&io, Form::text); });
    }

    /// Whether there is a clone, which saves the same.
    template <class Interface>
    static bool clones(Ov::RnCastable& object) {
        const auto original = Ov::rnQuery<Interface>(&object);
        const auto clone = original ? original->clone() : RnRef<Interface>();
        return clone && spared([&] { return saved(*clone) == saved(object); });
    }

    RnRef<Ov::RnCastable> lamp(auto lamp, int number) {
        lamp->setFlux(static_cast<float>(number));
        return lamp;
    }

    /// A file of the format. Its light and its grid tell it from files of other numbers.
    template <class Format>
    std::string file(int number) {
        const auto source =
            import(IesText{.lumens = 1000.0 * number, .horizontal = {0, 45.0 * number, 90.0 * number}}.text());
        return fileOf(immortal<PhotoWebBuilder<Format>>(), *makeWebDistribution(*source));
    }
};

TEST_F(Failures, OfObjects) {
    const struct {
        const char* name;
        std::function<RnRef<Ov::RnCastable>(int number)> make;
    } classes[] = {{"IES", [&](int number) { return import <IesFormat>(file<IesFormat>(number)); }},
                   {"CIBSE", [&](int number) { return import <CibseFormat>(file<CibseFormat>(number)); }},
                   {"NIMB", [&](int number) { return import <NimbFormat>(file<NimbFormat>(number)); }},
                   {"TBT", [&](int number) { return import <TbtFormat>(file<TbtFormat>(number)); }},
                   {"web", [&](int number) { return makeWebDistribution(*import(file<IesFormat>(number))); }},
                   {"isotropic", [&](int number) { return lamp(Ov::rnCreate<Isotropic>(), number); }},
                   {"diffuse", [&](int number) { return lamp(Ov::rnCreate<Diffuse>(), number); }},
                   {"spotlight", [&](int number) { return lamp(Ov::rnCreate<Spotlight>(), number); }},
                   {"natural light", [&](int number) {
                        auto light = Ov::rnCreate<DaylightData>();
                        light->setDayOfYear(static_cast<std::uint16_t>(number));
                        return light;
                    }}};
    for (const auto& [name, make] : classes) {
        SCOPED_TRACE(name);
        const auto object = make(1), other = make(2);
        auto* const builder = builderTable().find(Ov::rnCast<Ov::RnPersistant>(object.get())->getClassId());
        atEveryPlace("create", *object, [&] {
            RnRef<Ov::RnCastable> made;
            EXPECT_NO_THROW(made = builder->create());
            return made ? true : throw std::bad_alloc();
        });
        atEveryPlace("clone", *object, [&] {
            return clones<Ov::RnPhotoWebData>(*object) || clones<Ov::RnIntensityDist>(*object) ||
                   clones<Ov::RnNaturalLight>(*object);
        });
        for (const Form form : {Form::text, Form::binary}) {
            const std::string bytes = saved(*other, form);
            const auto whole = Ov::rnCreate<Ov::RnMemoryBuffer>();
            Ov::RnStream(whole.get(), form) << other.get();
            for (const bool faithful : {true, false}) {
                saveWebsFaithfully(faithful);
                atEveryPlace("save", *object, [&] {
                    const auto io = spared([] { return Ov::rnCreate<FailingDevice>(); });
                    Ov::RnStream stream(io.get(), form);
                    try {
                        stream << object.get();
                    } catch (...) {
                        EXPECT_EQ(&stream.device(), io.get());
                        throw;
                    }
                    return true;
                });
            }
            atEveryPlace("read", *object, [&] {
                Ov::RnPostLoadList list;
                return !!Ov::RnStream(Ov::rnCreate<FailingDevice>(whole->bytes()).get(), form, &list)
                             .readObject(nullptr);
            });
            const auto target = make(1);
            atEveryPlace("load", *target, [&] {
                Ov::RnStream stream(Ov::rnCreate<FailingDevice>(bytes).get(), form);
                return Ov::rnCast<Ov::RnPersistant>(target.get())
                    ->load(stream, 0, L"a name too long for its own place", L"");
            });
            EXPECT_NE(saved(*target), saved(*object));
        }
    }
}

TEST_F(Failures, OfPartsOfFilesAreTold) {
    const auto web = import(IesText{}.text());
    const struct {
        const char* name;
        bool (*work)(IesFileRecord& record, Ov::RnStream& stream);
    } parts[] = {{"tilt", [](IesFileRecord& record, Ov::RnStream& in) { return iesReadTilt(record.tilt, in); }},
                 {"grid",
                  [](IesFileRecord& record, Ov::RnStream& in) {
                      record.grid.verticalCount = record.grid.horizontalCount = 9;
                      NumberText numbers(in, NumberText::AtEnd::notConverted);
                      return candelaGridRead(record.grid, numbers);
                  }},
                 {"new grid", [](auto& record, auto&) { return candelaGridAlloc(record.grid, 9, 9); }},
                 {"new record", [](auto& record, auto&) { return iesRecordInitForWriting(record); }},
                 {"NIMB text", [](auto&, auto& out) { return nimbWrite(NimbRecord(), out); }},
                 {"NIMB record",
                  [](auto&, auto&) {
                      NimbRecord record;
                      return nimbRecordFromDistribution(*spared([] { return Ov::rnCreate<Isotropic>(); }), record);
                  }},
                 {"TBT record", [](auto&, auto&) {
                      TbtFileRecord record;
                      return tbtRecordFromDistribution(*spared([] { return Ov::rnCreate<Isotropic>(); }), record);
                  }}};
    std::string numbers = "3 2 0 90 1 1 ";
    for (int number = 0; number < 100; ++number) numbers += std::to_string(number) + " ";
    for (const auto& [name, work] : parts)
        atEveryPlace(
            name, *web,
            [&] {
                const auto io = spared([&] { return Ov::rnCreate<FailingDevice>(numbers); });
                auto record = spared([] { return IesFileRecord(); });
                const auto stream = textStream(*io);
                return work(record, *stream);
            },
            true);
    CandelaGrid grid;
    constexpr int most = std::numeric_limits<int>::max();
    EXPECT_FALSE(candelaGridAlloc(grid, most, most));
    EXPECT_EQ(log.take(), "12936");
}

template <class Format>
class FailuresOfFiles : public Failures {};
using Formats = testing::Types<IesFormat, CibseFormat, NimbFormat, TbtFormat>;
TYPED_TEST_SUITE(FailuresOfFiles, Formats);

TYPED_TEST(FailuresOfFiles, AreToldAndLeaveNothing) {
    const std::string text = this->template file<TypeParam>(1);
    const auto web = this->template import <TypeParam>(text);
    const auto light = makeWebDistribution(*web);
    this->atEveryPlace(
        "read", *web,
        [&] {
            const auto io = this->spared([&] { return Ov::rnCreate<FailingDevice>(text); });
            auto record = this->spared([] { return typename TypeParam::Record(); });
            const auto stream = this->textStream(*io);
            return readRecord<TypeParam>(record, *stream, L"") &&
                   recordToWeb<TypeParam>(record, *web, L"a name too long for its own place", L"");
        },
        true);
    auto& importer = immortal<LidImporter>();
    this->atEveryPlace("import", *web, [&] {
        return !!importer.import(Ov::rnCreate<FailingDevice>(text).get(), L"a name too long for its own place",
                                 L"");
    });
    this->atEveryPlace("facts", *web, [&] {
        int count = 0;
        auto visitor = Ov::rnVisitor<const FileFact&>([&](const FileFact&) { ++count; });
        const bool well =
            immortal<PhotoWebBuilder<TypeParam>>().readFacts(*Ov::rnCreate<FailingDevice>(text), L"", visitor);
        EXPECT_EQ(well, count > 0);
        return well;
    });
    const FileFact facts[] = {{FactKind::keyword, L"LUMINAIRE", L"a fact too long for its own place"},
                              {FactKind::value, L"watts", L"12"}};
    for (const FileForm form : {FileForm::asSaved, FileForm::faithful})
        this->atEveryPlace(
            "write", *light,
            [&] {
                const auto io = this->spared([] { return Ov::rnCreate<FailingDevice>(); });
                const auto stream = this->textStream(*io);
                const bool well = immortal<PhotoWebBuilder<TypeParam>>().write(*light, *stream, form, facts, 2);
                EXPECT_EQ(well, !io->bytes().empty());
                return well;
            },
            true);
}

}  // namespace
}  // namespace OvPhotometrics
