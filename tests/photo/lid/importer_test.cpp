#include "components/photo/lid/importer.h"

#include "components/photo/cibse/photoWebCIBSE.h"
#include "components/photo/distributions/diffuse.h"
#include "components/photo/nimb/photoWebNIMB.h"
#include "components/photo/tbt/photoWebTBT.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

class Importer : public Photo {
protected:
    Importer() : importer(Ov::rnCast<Ov::RnImporter>(immortal<LidImporter>().create().get())) {}

    /// A file of a format is imported as such, by path and from a device.
    template <class Format>
    void imports() {
        SCOPED_TRACE(Format::extension);
        const auto lamp = Ov::rnCreate<Diffuse>();
        lamp->setFlux(1000);
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
        ASSERT_TRUE(immortal<PhotoWebBuilder<Format>>().write(*lamp, stream, FileForm::asSaved, nullptr, 0));
        const std::wstring path = folder.write("lamp.any", io->bytes());
        io->seek(0, 0);
        bool recognised = false;
        for (const auto& web :
             {importer->import(path.c_str(), nullptr, recognised), importer->import(path.c_str(), nullptr),
              importer->import(Ov::RnPtr<Ov::RnBufferedIO>(io.get()), L"lamp", nullptr)}) {
            EXPECT_TRUE(dynamic_cast<typename Format::Web*>(web.get()));
            EXPECT_STREQ(Ov::rnCast<Ov::RnPhotoWebData>(web.get())->getName(), L"lamp");
        }
        EXPECT_TRUE(recognised);
    }

    RnRef<Ov::RnImporter> importer;
    TempFolder folder;
};

TEST_F(Importer, KnowsAFormatByItsContent) {
    imports<CibseFormat>();
    imports<IesFormat>();
    imports<NimbFormat>();
    imports<TbtFormat>();
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
    EXPECT_STREQ(importer->getDefaultSearch(), L"*.cib;*.ies;*.nmb;*.tbt");
    EXPECT_TRUE(std::wstring(importer->getFileTypes()).starts_with(L"All (*.cib;*.ies;*.nmb;*.tbt)|*.cib;"));
}

}  // namespace
}  // namespace OvPhotometrics
