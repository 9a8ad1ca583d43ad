#include <cstdlib>
#include <new>

#include "components/photo/cibse/photoWebCIBSE.h"
#include "components/photo/distributions/web.h"
#include "components/photo/nimb/photoWebNIMB.h"
#include "components/photo/tbt/photoWebTBT.h"
#include "tests/photo/photoFixture.h"

// Memory that runs out at every allocation in turn, through loading and writing of every format.

namespace {

long untilFailure = -1;  // allocations until one fails; negative: none does

void* allocate(std::size_t size) {
    if (untilFailure >= 0 && untilFailure-- == 0) throw std::bad_alloc();
    void* const block = std::malloc(size > 0 ? size : 1);
    return block ? block : throw std::bad_alloc();
}

}  // namespace

void* operator new(std::size_t size) { return allocate(size); }
void* operator new[](std::size_t size) { return allocate(size); }
void operator delete(void* block) noexcept { std::free(block); }
void operator delete[](void* block) noexcept { std::free(block); }
void operator delete(void* block, std::size_t) noexcept { std::free(block); }
void operator delete[](void* block, std::size_t) noexcept { std::free(block); }

namespace OvPhotometrics {
namespace {

enum class Outcome { well, refused, outOfMemory };

template <class Format>
class Memory : public Photo {
protected:
    /// Does `work` with the n-th allocation failing. False once n is beyond the last of them.
    template <class Work>
    bool failing(long n, Outcome& outcome, Work work) {
        untilFailure = n;
        try {
            outcome = work() ? Outcome::well : Outcome::refused;
        } catch (const Ov::RnStreamEx&) {
            outcome = Outcome::refused;
        } catch (const std::bad_alloc&) {
            outcome = Outcome::outOfMemory;
        }
        const bool reached = untilFailure < 0;
        untilFailure = -1;
        return reached;
    }

    /// A file of the format, with a light that tells by `lumens`.
    std::string file(double lumens) {
        const auto source = this->import(IesText{.lumens = lumens, .horizontal = {0, 45, 90}}.text());
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
        immortal<PhotoWebBuilder<Format>>().write(*makeWebDistribution(*source), stream, FileForm::faithful, {});
        return io->bytes();
    }
};

using Formats = testing::Types<IesFormat, CibseFormat, NimbFormat, TbtFormat>;
TYPED_TEST_SUITE(Memory, Formats);

TYPED_TEST(Memory, AFailedLoadLeavesTheWebAsItWas) {
    const std::string other = this->file(2000);
    const auto original = this->template import <TypeParam>(this->file(1000));
    const std::string before = this->saved(*original);
    int failures = 0;
    for (long n = 0;; ++n) {
        const auto web = original->clone();
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(other);
        Outcome outcome;
        const bool reached = this->failing(n, outcome, [&] {
            Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
            return Ov::rnCast<Ov::RnPersistant>(web.get())->load(stream, 0, L"a name too long for its own",
                                                                 nullptr);
        });
        const std::string messages = this->log.take();
        if (!reached) break;
        EXPECT_NE(outcome, Outcome::well) << "allocation " << n;
        EXPECT_TRUE(outcome != Outcome::refused || messages.find("12936") != std::string::npos)
            << n << ": " << messages;
        EXPECT_EQ(this->saved(*web), before) << "allocation " << n;
        failures += outcome == Outcome::refused;
    }
    EXPECT_GE(failures, 2);
}

TYPED_TEST(Memory, AFailedFileIsNoFile) {
    const auto web = this->template import <TypeParam>(this->file(1000));
    const auto dist = makeWebDistribution(*web);
    for (const FileForm form : {FileForm::asSaved, FileForm::faithful}) {
        for (long n = 0;; ++n) {
            const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
            Outcome outcome;
            const bool reached = this->failing(n, outcome, [&] {
                Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
                return immortal<PhotoWebBuilder<TypeParam>>().write(*dist, stream, form, {});
            });
            const std::string messages = this->log.take();
            if (!reached) break;
            EXPECT_NE(outcome, Outcome::well) << "allocation " << n;
            EXPECT_TRUE(outcome != Outcome::refused || !messages.empty()) << "allocation " << n;
        }
    }
}

}  // namespace
}  // namespace OvPhotometrics
