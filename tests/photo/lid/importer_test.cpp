#include "components/photo/lid/importer.h"

#include <cstdlib>
#include <filesystem>

#include "components/photo/distributions/diffuse.h"
#include "components/photo/nimb/photoWebNIMB.h"
#include "support/paths.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

class Importer : public Photo {
protected:
    Importer() : importer(Ov::rnCast<Ov::RnImporter>(immortal<LidImporter>().create().get())) {}

    RnRef<Ov::RnImporter> importer;
    TempFolder folder;
};

TEST_F(Importer, KnowsAFormatByItsContent) {
    const auto lamp = Ov::rnCreate<Diffuse>();
    lamp->setFlux(1000);
    int formats = 0;
    for (const auto& [id, builder] : builderTable()) {
        const auto format = Ov::rnQuery<Ov::RnPhotoFormat>(builder);
        if (!format) continue;
        ++formats;
        const std::string file = fileOf(*format, *lamp, {}, FileForm::asSaved);
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(file);
        const std::wstring path = folder.write("lamp.any", file);
        bool recognised = false;
        for (const auto& web :
             {importer->import(path.c_str(), nullptr, recognised), importer->import(path.c_str(), nullptr),
              importer->import(Ov::RnPtr<Ov::RnBufferedIO>(io.get()), L"lamp", nullptr)}) {
            EXPECT_EQ(Ov::rnCast<Ov::RnPersistant>(web.get())->getClassId(), *id);
            EXPECT_STREQ(Ov::rnCast<Ov::RnPhotoWebData>(web.get())->getName(), L"lamp");
        }
        EXPECT_TRUE(recognised);
    }
    EXPECT_GE(formats, 4);
    bool recognised = true;
    EXPECT_FALSE(importer->import(folder.write("no.ies", "neither").c_str(), nullptr, recognised));
    EXPECT_FALSE(recognised);
    EXPECT_THROW(importer->import(folder.write("cut.ies", "IESNA91").c_str(), nullptr),
                 Ov::RnStreamEx::ExReadError);
    EXPECT_EQ(log.take(), "12945 12956");
}

/// Makers' files, read where OVPHOTO_SAMPLES says they lie, and the examples. The rest is for the replays in fuzz/.
TEST_F(Importer, ReadsMostFilesOfMakers) {
    std::vector<std::string> folders{sourceFolder() + "/examples"};
    if (const char* samples = std::getenv("OVPHOTO_SAMPLES")) folders.emplace_back(samples);
    int files = 0, read = 0;
    for (const std::string& each : folders)
        for (const auto& entry : std::filesystem::directory_iterator(each)) {
            if (entry.path().extension() != ".ies") continue;
            ++files;
            try {
                read += !!immortal<IESBuilder>().import(Ov::widePath(entry.path()).c_str(), nullptr);
                EXPECT_EQ(log.take(), "") << entry.path();
            } catch (const Ov::RnStreamEx::ExReadError&) {
                EXPECT_NE(log.take(), "") << entry.path();
            }
        }
    EXPECT_GT(read, files / 2);
}

TEST_F(Importer, OffersThePhotometricWebs) {
    EXPECT_FALSE(immortal<LidImporter>().isCreatable());
    for (const Ov::RnUid& id : {Ov::RnComponentBuilder::iid, Ov::RnBuilderDescription::iid, Ov::RnImporter::iid}) {
        EXPECT_TRUE(importer->hasInterface(id));
        EXPECT_TRUE(RnRef<Ov::RnCastable>::adopt(importer->getInterface(id)));
    }
    EXPECT_FALSE(importer->hasInterface(Ov::RnImportBuilder::iid));
    EXPECT_FALSE(importer->getInterface(Ov::RnImportBuilder::iid));
    EXPECT_STREQ(importer->getDefaultSearch(), L"*.cib;*.ies;*.nmb;*.tbt");
    EXPECT_TRUE(std::wstring(importer->getFileTypes()).starts_with(L"All (*.cib;*.ies;*.nmb;*.tbt)|*.cib;"));
}

class PhotoWebReadOnly;

/// NIMB files of a format that writes none and tells no facts.
struct ReadOnlyFormat {
    using Web = PhotoWebReadOnly;
    using Record = NimbRecord;
    static constexpr BuilderInfo info{classIds::make(0x7070f200), photometricWebCategory, L"READ Web",
                                      L"Read only"};
    static constexpr Ov::PhotoFormatTraits traits{.name = L"READ"};
    static constexpr const wchar_t* extension = L"read";
    static constexpr const char* source = "importer_test";
    static constexpr int saveLine = 1;
    static constexpr int loadLine = 2;
    static constexpr const char* streamName = "READ stream";
    static constexpr auto canImport = nimbCanRead;
    static constexpr auto read = nimbRead;
    static constexpr auto toWeb = nimbToWeb;
};

class PhotoWebReadOnly final : public PhotoWebOf<PhotoWebReadOnly, ReadOnlyFormat> {};

TEST_F(Importer, AFormatMayBeReadAlone) {
    const auto lamp = Ov::rnCreate<Diffuse>();
    lamp->setFlux(1000);
    const auto web = import <ReadOnlyFormat>(fileOf(immortal<NIMBBuilder>(), *lamp));
    ASSERT_TRUE(web);

    auto& format = immortal<PhotoWebBuilder<ReadOnlyFormat>>();
    EXPECT_FALSE(format.getTraits().writes || format.getTraits().readsFacts);
    EXPECT_EQ(fileOf(format, *distributionOf(*web)), "");
    EXPECT_EQ(log.take(), "13084 READ");
    EXPECT_THROW(saved(*web), Ov::RnStreamEx::ExWriteError);
    EXPECT_EQ(log.take(), "13084 READ");
}

}  // namespace
}  // namespace OvPhotometrics
