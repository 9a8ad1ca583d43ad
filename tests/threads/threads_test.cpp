#include <atomic>
#include <thread>

#include "components/photo/distributions/web.h"
#include "ovphoto/classIds.h"
#include "tests/photo/photoFixture.h"

// What many threads may do at once.

namespace OvPhotometrics {
namespace {

class Threads : public Photo {
protected:
    /// Does `work` on several threads that start together.
    template <class Work>
    static void together(const Work& work) {
        constexpr int count = 4;
        std::atomic<int> waiting = count;
        std::vector<std::thread> threads;
        for (int i = 0; i < count; ++i)
            threads.emplace_back([&] {
                for (--waiting; waiting > 0;) std::this_thread::yield();
                work();
            });
        for (std::thread& thread : threads) thread.join();
    }

    const RnRef<PhotoWebIES> web =
        import(IesText{.vertical = {0, 30, 45, 90, 180}, .horizontal = {0, 45, 90, 180, 270}}.text());
};

TEST_F(Threads, TakeAndDropReferences) {
    auto light = distributionOf(*web);
    std::atomic<bool> areDistinct = true;
    together([&] {
        for (int i = 0; i < 5000; ++i) {
            const auto again = light;
            const auto adapter = Ov::rnCast<Ov::RnPersistant>(web.get());
            const auto clone = light->clone();  // holds the web, too
            if (clone.get() == light.get()) areDistinct = false;
        }
    });
    EXPECT_TRUE(areDistinct);
    EXPECT_EQ(light.detach()->release(), -1);
    web->newReference();
    EXPECT_EQ(web->release(), 0);
}

TEST_F(Threads, AskOneLight) {
    const auto light = distributionOf(*web);
    const auto sum = [&] {
        double all = 0;
        for (int theta = 0; theta <= 180; ++theta)
            for (int psi = 0; psi < 360; psi += 7)
                all += light->intensity(toRadians(theta), toRadians(psi)) +
                       light->intensityAt(direction(theta, psi)) +
                       web->getIntensity(toRadians(theta), toRadians(psi)) + web->getCandela(psi, theta);
        return all + light->getFlux() + web->getLumens();
    };
    const double alone = sum();
    std::atomic<int> different = 0;
    together([&] { different += sum() != alone; });
    EXPECT_GT(alone, 0);
    EXPECT_EQ(different, 0);
}

TEST_F(Threads, CreateAndLoadObjectsOfTheirOwn) {
    std::atomic<int> wrong = 0;
    const auto manager = Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager());
    together([&] {
        for (int i = 1; i <= 500; ++i) {
            Ov::RnStream stream(Ov::rnCreate<Ov::RnMemoryBuffer>().get(), Form::binary);
            const auto lamp = Ov::rnCast<Ov::RnIntensityDist>(manager->createObject(classIds::spotlight).get());
            lamp->setFlux(static_cast<float>(i));
            stream << lamp.get();
            stream.device().seek(0, 0);
            Ov::RnPostLoadList list;
            Ov::RnStream in(&stream.device(), Form::binary, &list);
            wrong += Ov::rnCast<Ov::RnIntensityDist>(in.readObject(nullptr).get())->getFlux() != lamp->getFlux();
        }
    });
    EXPECT_EQ(wrong, 0);
}

}  // namespace
}  // namespace OvPhotometrics
