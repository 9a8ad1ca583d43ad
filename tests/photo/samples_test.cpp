#include <filesystem>

#include "support/paths.h"
#include "tests/photo/photoFixture.h"

// Makers' files, read where OVPHOTO_SAMPLES says they lie, and the examples. What light they give and what is written of
// them is for the replays in fuzz/.

namespace OvPhotometrics {
namespace {

class Samples : public Photo {};

TEST_F(Samples, AreReadOrRefusedWithAMessage) {
    std::vector<std::filesystem::directory_entry> entries;
    std::vector<std::string> folders{sourceFolder() + "/examples"};
    if (const char* samples = std::getenv("OVPHOTO_SAMPLES")) folders.emplace_back(samples);
    for (const std::string& folder : folders)
        entries.insert(entries.end(), std::filesystem::directory_iterator(folder), {});
    int files = 0, read = 0;
    for (const auto& entry : entries) {
        if (entry.path().extension() != ".ies") continue;
        SCOPED_TRACE(entry.path());
        ++files;
        RnRef<Ov::RnCastable> object;
        try {
            object = immortal<IESBuilder>().import(Ov::widePath(entry.path()).c_str(), nullptr);
        } catch (const Ov::RnStreamEx::ExReadError&) {
            EXPECT_NE(log.take(), "");
            continue;
        }
        EXPECT_EQ(log.take(), "");
        ++read;
        const auto web = Ov::rnCast<Ov::RnPhotoWebData>(object.get());
        const std::string text = saved(*web);
        if (const auto again = import(text)) {
            EXPECT_EQ(again->getThetaCount(), web->getThetaCount());
        }
        log.take();
    }
    EXPECT_GT(files, 0);
    EXPECT_GT(read, files / 2);
}

}  // namespace
}  // namespace OvPhotometrics
