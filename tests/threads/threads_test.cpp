#include <array>
#include <atomic>
#include <thread>

#include "components/photo/distributions/web.h"
#include "components/photo/naturallight/calendar.h"
#include "components/photo/naturallight/timeZones.h"
#include "host/componentManager/importer.h"
#include "ovphoto/classIds.h"
#include "ovphoto/naturalLight.h"
#include "tests/photo/photoFixture.h"

// What many threads may do at once.

namespace OvPhotometrics {
namespace {

class Threads : public Photo {
protected:
    /// Does `work`, which may take the number of its thread, on several threads that start together.
    template <class Work>
    static void together(const Work& work, int count = 4) {
        std::atomic<int> waiting = count;
        std::vector<std::thread> threads;
        for (int i = 0; i < count; ++i)
            threads.emplace_back([&, i] {
                for (--waiting; waiting > 0;) std::this_thread::yield();
                if constexpr (std::is_invocable_v<Work, int>)
                    work(i);
                else
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

TEST_F(Threads, AskForTextsThatNobodyHasAskedFor) {
    const std::wstring file = Ov::messageFile().fileName();
    const auto names = [] {
        std::wstring all;
        for (int month = 1; month <= monthsInYear; ++month) all += getMonthName(month);
        for (int zone = 0; zone < getTimeZoneCount(); ++zone) all += getTimeZoneName(zone);
        return all;
    };
    const std::wstring alone = names();
    std::atomic<int> wrong = 0;
    for (int round = 0; round < 50; ++round) {
        Ov::releaseTexts();
        Ov::messageFile().setFileName(file.c_str());
        together([&] { wrong += names() != alone; });
    }
    EXPECT_EQ(wrong, 0);
}

/// Files of all formats, good and refused, whose light and messages tell the number of their thread.
std::array<std::string, 9> filesOf(int number) {
    const std::string n = std::to_string(number), feeds(static_cast<std::size_t>(number), '\n');
    const std::string cibse = "CIBSE/1\n\n\n\n\n\n\n\n1 ";
    const std::string nimb =
        "  90  90  45  90   0   0   0NIMB\nlines\nof\nseventy-two bytes\nor more\n   1   2   ";
    const std::string tbt = "Spot\n3\n1 0.5 0\n1200 1000 1.2 1 5 0\n3 5 2\n100 80 50 Z0\n100 " + feeds;
    return {IesText{.horizontal = {0, 45, 90 + 0.01 * number}}.text(),
            IesText{.header = "IESNA91\n", .tilt = "none" + n + ".tlt\n"}.text(),
            "IESNA91\nTILT=NONE\n-" + n + " 1",
            cibse + "1 0 0 0 2 0 0 0 2 1 0 90 0 5." + n + " 1 99 0 0 0",
            cibse + "5" + n,
            "   1   0" + nimb + n,
            "   1 35" + n + nimb + n,
            tbt + "90 0 0 1" + n + "\n-1\n",
            tbt + "x"};
}

/// What the reporter has told on this thread.
thread_local std::string heard;

TEST_F(Threads, ImportFilesOfAllFormatsWhileOthersEvaluateAndSave) {
    constexpr int importing = 8, others = 3, importsEach = 2500;
    const auto manager = Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager());
    const auto imported = [&](const std::string& file) {
        const auto importer = Ov::rnCast<Ov::RnImporter>(manager->createObject(classIds::importer).get());
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(file);
        heard.clear();
        try {
            const auto object = importer->import(Ov::RnPtr<Ov::RnBufferedIO>(io.get()), L"lamp", nullptr);
            return object ? heard + saved(*object) : "unknown";
        } catch (const Ov::RnStreamEx::ExReadError& failure) {
            return heard + failure.getReason();
        }
    };
    // One message in a hundred makes the reporter import a file that is refused.
    const std::string another = filesOf(importing)[2];
    int messages = 0, depth = 0,
        wrongInside = 0;  // without a lock: the reporter is called by one thread at a time
    const auto before = Ov::setMessageReporter([&](int, const wchar_t* text) {
        const std::wstring whole = text;
        if (++depth == 1 && ++messages % 100 == 0) {
            const std::string outside = std::exchange(heard, "");
            wrongInside += imported(another) != "12945 12959 -8;IES stream" || whole != text;
            heard = outside;
        }
        --depth;
        heard += Ov::toUtf8(text) + ';';
    });

    std::vector<std::vector<std::string>> alone;
    std::set<std::string> different;
    for (int i = 0; i < importing; ++i) {
        auto& results = alone.emplace_back();
        for (const std::string& file : filesOf(i)) different.insert(results.emplace_back(imported(file)));
    }
    EXPECT_FALSE(different.contains("unknown"));
    EXPECT_EQ(different.size(), importing * 9U);
    const auto light = distributionOf(*web);
    const auto everythingElse = [&] {
        const auto sun = Ov::rnCast<Ov::RnNaturalLight>(manager->createObject(classIds::naturalLight).get());
        double sum = light->getFlux() + web->getLumens() + sun->getSolarAltitude();
        for (int theta = 0; theta <= 180; theta += 3)
            for (int psi = 0; psi < 360; psi += 7)
                sum += light->intensity(toRadians(theta), toRadians(psi)) +
                       light->intensityAt(direction(theta, psi)) + web->getCandela(psi, theta);
        Ov::RnStream stream(Ov::rnCreate<Ov::RnMemoryBuffer>().get(), Form::binary);
        stream << light.get();
        stream.device().seek(0, 0);
        Ov::RnPostLoadList list;
        Ov::RnStream in(&stream.device(), Form::binary, &list);
        return std::to_string(sum) + saved(*light) + saved(*web) + saved(*sun) + saved(*in.readObject(nullptr));
    };
    const std::string expected = everythingElse();

    // The file of texts is opened by whoever comes first.
    Ov::messageFile().setFileName(Ov::messageFile().fileName().c_str());
    std::atomic<int> wrong = 0, left = importing * importsEach;
    together(
        [&](int thread) {
            if (thread >= importing) {
                while (left > 0) wrong += everythingElse() != expected;
                return;
            }
            const auto files = filesOf(thread);
            for (std::size_t i = 0; i < importsEach; ++i, --left)
                wrong +=
                    imported(files[i % files.size()]) != alone[static_cast<std::size_t>(thread)][i % files.size()];
        },
        importing + others);
    EXPECT_EQ(wrong, 0);
    EXPECT_EQ(wrongInside, 0);
    EXPECT_GT(messages, importing * importsEach / 2);
    Ov::setMessageReporter(before);
}

}  // namespace
}  // namespace OvPhotometrics
