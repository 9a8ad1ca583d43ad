#include "components/photo/lid/importer.h"

#include "components/photo/nimb/photoWebNIMB.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

class Importer : public Photo {
protected:
    Importer() : importer(Ov::rnCast<Ov::RnImporter>(immortal<LidImporter>().create().get())) {}

    RnRef<Ov::RnImporter> importer;
};

const std::string nimb =
    "   1   0  90  90  90  90   0   0   0NIMB\n" + std::string(72, 'x') + "\n\n\n\n   1   2\n";

TEST_F(Importer, KnowsAFormatByItsContent) {
    const std::pair<std::string, bool (*)(Ov::RnCastable*)> files[] = {
        {IesText{}.text(), [](Ov::RnCastable* web) { return dynamic_cast<PhotoWebIES*>(web) != nullptr; }},
        {nimb, [](Ov::RnCastable* web) { return dynamic_cast<PhotoWebNIMB*>(web) != nullptr; }}};
    const TempFolder folder;
    for (const auto& [text, isOfFormat] : files) {
        const std::wstring path = folder.write("lamp.any", text);
        bool recognised = false;
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(text);
        const RnRef<Ov::RnCastable> webs[] = {
            importer->import(path.c_str(), nullptr, recognised), importer->import(path.c_str(), nullptr),
            importer->import(Ov::RnPtr<Ov::RnBufferedIO>(io.get()), L"lamp", nullptr)};
        EXPECT_TRUE(recognised);
        for (const auto& web : webs) {
            EXPECT_TRUE(isOfFormat(web.get()));
            EXPECT_STREQ(Ov::rnCast<Ov::RnPhotoWebData>(web.get())->getName(), L"lamp");
        }
    }
    bool recognised = true;
    EXPECT_FALSE(importer->import(folder.write("no.ies", "neither").c_str(), nullptr, recognised));
    EXPECT_FALSE(recognised);
    EXPECT_THROW(importer->import(folder.write("cut.ies", "IESNA91").c_str(), nullptr),
                 Ov::RnStreamEx::ExReadError);
    EXPECT_EQ(log.take(), "12945 12956");
}

TEST_F(Importer, OffersThePhotometricWebs) {
    EXPECT_FALSE(immortal<LidImporter>().isCreatable());
    for (const Ov::RnUid& id : {Ov::RnComponentBuilder::iid, Ov::RnBuilderDescription::iid, Ov::RnImporter::iid}) {
        EXPECT_TRUE(importer->hasInterface(id));
        EXPECT_TRUE(RnRef<Ov::RnCastable>::adopt(importer->getInterface(id)));
    }
    EXPECT_FALSE(importer->hasInterface(Ov::RnImportBuilder::iid));
    EXPECT_FALSE(importer->getInterface(Ov::RnImportBuilder::iid));
    const std::wstring patterns = importer->getDefaultSearch();
    for (const wchar_t* pattern : {L"*.ies", L"*.nmb"}) EXPECT_NE(patterns.find(pattern), std::wstring::npos);
    EXPECT_TRUE(std::wstring(importer->getFileTypes()).starts_with(L"All (" + patterns + L")|" + patterns + L"|"));
}

}  // namespace
}  // namespace OvPhotometrics
