#include <gmock/gmock.h>

#include <filesystem>

#include "components/support/devices.h"
#include "components/support/path.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/importer.h"
#include "ovphoto/classIds.h"
#include "ovphoto/photoFormat.h"
#include "ovphoto/photoWebData.h"
#include "support/paths.h"
#include "tool/toolRun.h"

// A format in a module of its own is found by the importer of the library's and by the tool, which know nothing of it.

namespace {

namespace fs = std::filesystem;

const std::string lamp = "TOY\nA lamp\n900 800 700 600 500 400 300 200 100 0\n";
const std::string toyModule = binFolder() + "/toy/libOVtoy.so";

TEST(Toy, TheImporterAsksItInItsTurn) {
    const auto manager = Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager());
    manager->loadModule(Ov::fromUtf8(modulePath()).c_str());
    manager->loadModule(Ov::fromUtf8(toyModule).c_str());
    const auto importer =
        Ov::rnCast<Ov::RnImporter>(manager->createObject(OvPhotometrics::classIds::importer).get());
    std::string names;
    auto visitor = Ov::rnVisitor<Ov::RnCPtr<Ov::RnImportBuilder>>([&](Ov::RnCPtr<Ov::RnImportBuilder> builder) {
        auto* const asked = const_cast<Ov::RnImportBuilder*>(builder.get());
        names += Ov::toUtf8(Ov::rnCast<Ov::RnPhotoFormat>(asked)->getTraits().name) + " ";
    });
    importer->enumerateObjects(visitor);
    EXPECT_EQ(names, "TOY CIBSE IES NIMB TBT ");
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(lamp);
    const auto web = Ov::rnCast<Ov::RnPhotoWebData>(
        importer->import(Ov::RnPtr<Ov::RnBufferedIO>(io.get()), L"lamp", L"").get());
    EXPECT_EQ(web->getMaxCandela(), 900);
    EXPECT_EQ(web->getThetaCount(), 10);
}

class ToyTool : public testing::Test {
protected:
    /// The modules lie side by side, as they would be installed.
    ToyTool() {
        for (const std::string& file : {modulePath(), binFolder() + "/libOVphotoRes.dll", toyModule})
            fs::copy_file(file, Ov::nativePath(folder.wide(fs::path(file).filename().string())));
        folder.write("lamp.toy", lamp);
    }

    ToolResult run(const std::string& arguments) {
        return runTool("--module " + Ov::toUtf8(folder.wide("libOVphoto.so")) + " " + arguments, folder);
    }

    TempFolder folder;
};

TEST_F(ToyTool, ReadsShowsAndConvertsIt) {
    EXPECT_THAT(run("formats").out, testing::HasSubstr("TOY Photometric Web"));
    EXPECT_THAT(run("check lamp.toy").out, testing::StartsWith("ok       TOY"));
    const ToolResult info = run("info lamp.toy");
    for (const char* part : {"TOY", "900 cd", "A lamp"}) EXPECT_THAT(info.out, testing::HasSubstr(part));
    // By extension and by name, from it and to it, the luminaire's name with it.
    EXPECT_EQ(run("convert lamp.toy lamp.ies").status, 0);
    EXPECT_THAT(run("info lamp.ies").out, testing::HasSubstr("A lamp"));
    EXPECT_EQ(run("convert --to toy lamp.ies again.out").status, 0);
    EXPECT_THAT(run("intensity --as toy again.out 40,0").out, testing::HasSubstr("500"));
    EXPECT_EQ(run("make diffuse new.toy").status, 0);
    // Another module has the texts of its own: without them a message is its number.
    folder.write("bad.toy", "TOY\nx\n1 2 x");
    const ToolResult refused = run("check bad.toy");
    EXPECT_EQ(refused.status, 1);
    EXPECT_THAT(refused.out, testing::HasSubstr("Message 129"));
}

TEST_F(ToyTool, WithoutTheModuleNobodyKnowsIt) {
    fs::remove(Ov::nativePath(folder.wide("libOVtoy.so")));
    EXPECT_THAT(run("check lamp.toy").out, testing::HasSubstr("not a photometric file of a known format"));
    const ToolResult wrong = run("check --as toy lamp.toy");
    EXPECT_EQ(wrong.status, 2);
    EXPECT_THAT(wrong.err, testing::HasSubstr("toy not in {CIBSE,IES,NIMB,TBT}"));
}

}  // namespace
