#include "components/module/registration.h"
#include "components/photo/files/photoWebComponent.h"
#include "components/photo/lid/component.h"
#include "components/support/immortal.h"
#include "ovphoto/classIds.h"

// A module of its own with a format of its own, as others would make it: the light of ten angles from nadir up.
//
//     TOY
//     the luminaire's name
//     ten candela, at 0 to 90 degrees from its axis

namespace OvPhotometrics {

namespace {

class PhotoWebTOY;

constexpr int angles = 10;
constexpr float step = pi / 2 / (angles - 1);

struct ToyFormat {
    using Web = PhotoWebTOY;
    struct Record {
        std::wstring name;
        std::vector<float> candela;
    };
    static constexpr BuilderInfo info{classIds::make(0x7070f100), photometricWebCategory, L"TOY Web",
                                      L"TOY Photometric Web"};
    static constexpr Ov::PhotoFormatTraits traits{.name = L"TOY", .preference = 50, .grids = Ov::PhotoGrids::even};
    static constexpr const wchar_t* extension = L"toy";
    static constexpr const char* source = "tests/toy/toyModule";
    static constexpr int saveLine = 1;
    static constexpr int loadLine = 2;
    static constexpr const char* streamName = "TOY stream";

    static bool canImport(Ov::RnBufferedIO& io) { return matchesAt(io, L"TOY\n"); }

    static bool read(Record& rec, Ov::RnStream& in) {
        std::wstring signature;
        NumberText numbers(in, NumberText::AtEnd::notConverted);
        return readTextLine(in, L"%80[^\r\n]", signature) && readTextLine(in, L"%80[^\r\n]", rec.name) &&
               numbers.readFloats(angles, rec.candela);
    }

    static bool toWeb(const Record& rec, Web& web, bool loaded, const wchar_t* name);

    static bool fromDistribution(Ov::RnIntensityDist& light, Record& rec) {
        for (int i = 0; i < angles; ++i) rec.candela.push_back(light.intensity(step * static_cast<float>(i), 0));
        return true;
    }
    static constexpr auto fromDistributionFaithfully = fromDistribution;

    static bool write(const Record& rec, Ov::RnStream& out) {
        writeLine(out, L"TOY");
        writeLine(out, L"%s", rec.name.c_str());
        for (const float candela : rec.candela) writeLine(out, L"%.2f", candela);
        return true;
    }

    static void describe(const Record& rec, FileFacts& facts) {
        facts.add(L"LUMINAIRE", rec.name, FactKind::keyword);
    }
    static void carry(const FileFacts& facts, const std::wstring& name, Record& rec) {
        const std::wstring* const known = facts.find(L"LUMINAIRE");
        rec.name = known ? *known : name;
    }
};

class PhotoWebTOY final : public PhotoWebOf<PhotoWebTOY, ToyFormat> {};

bool ToyFormat::toWeb(const Record& rec, Web& web, bool loaded, const wchar_t* name) {
    return installOrReport([&] {
        PhotoWebRecord made;
        photoWebRecordInit(made, angles, 1, PhotoWebSymmetry::Axial, false, loaded, name);
        for (int i = 0; i < angles; ++i) photoWebRecordSetTheta(made, i, step * static_cast<float>(i));
        photoWebRecordSetRow(made, 0, rec.candela.data(), 1);
        return photoWebInstall(web, made);
    });
}

}  // namespace

void registerBuilders() { builderTable().add(immortal<PhotoWebBuilder<ToyFormat>>()); }

}  // namespace OvPhotometrics
