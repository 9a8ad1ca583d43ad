#pragma once

#include "components/photo/files/photoWebComponent.h"
#include "components/photo/tbt/tbt.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

class PhotoWebTBT;

struct TbtFormat {
    using Web = PhotoWebTBT;
    using Record = TbtFileRecord;
    static constexpr BuilderInfo info{classIds::tbtWeb, photometricWebCategory, L"TBT Web",
                                      L"TBT Photometric Web"};
    static constexpr Ov::PhotoFormatTraits traits{.name = L"TBT",
                                                  .preference = 900,
                                                  .unit = Ov::PhotoValueUnit::candelaPerKilolumen,
                                                  .grids = Ov::PhotoGrids::even,
                                                  .holdsLampLumens = true,
                                                  .namesLines = true};
    static constexpr const wchar_t* extension = L"tbt";
    static constexpr const char* source = "components/photo/tbt/tbt";
    static constexpr int saveLine = 230;
    static constexpr int loadLine = 241;
    static constexpr const char* streamName = "TBT stream";

    static constexpr auto canImport = tbtCanRead;
    static constexpr auto read = tbtRead;
    static constexpr auto toWeb = tbtToWeb;
    static constexpr auto fromDistribution = tbtRecordFromDistribution;
    static constexpr auto fromDistributionFaithfully = tbtRecordFromDistributionFaithfully;
    static constexpr auto write = tbtWrite;
    static constexpr auto describe = tbtDescribe;
    static constexpr auto carry = tbtCarry;
    static std::span<std::wstring> texts(TbtFileRecord& rec) { return {&rec.title, 1}; }
    static constexpr std::size_t textLimit = tbtTitleLength;
};

/// A web read from a TBT file.
class PhotoWebTBT final : public PhotoWebOf<PhotoWebTBT, TbtFormat> {};

using PhotoWebTBTPersistant = PhotoWebPersistant<TbtFormat>;
using TBTBuilder = PhotoWebBuilder<TbtFormat>;

}  // namespace OvPhotometrics
