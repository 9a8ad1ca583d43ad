#pragma once

#include "components/photo/files/photoWebComponent.h"
#include "components/photo/nimb/nimb.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

class PhotoWebNIMB;

struct NimbFormat {
    using Web = PhotoWebNIMB;
    using Record = NimbRecord;
    static constexpr BuilderInfo info{classIds::nimbWeb, photometricWebCategory, L"NIMB Web",
                                      L"NIMB Photometric Web"};
    static constexpr Ov::PhotoFormatTraits traits{
        .name = L"NIMB", .preference = 300, .grids = Ov::PhotoGrids::even, .namesLines = true};
    static constexpr const wchar_t* extension = L"nmb";
    static constexpr const char* source = "components/photo/nimb/nimb";
    static constexpr int saveLine = 237;
    static constexpr int loadLine = 248;
    static constexpr const char* streamName = "NIMB stream";

    static constexpr auto canImport = nimbCanRead;
    static constexpr auto read = nimbRead;
    static constexpr auto toWeb = nimbToWeb;
    static constexpr auto fromDistribution = nimbRecordFromDistribution;
    static constexpr auto fromDistributionFaithfully = nimbRecordFromDistributionFaithfully;
    static constexpr auto write = nimbWrite;
    static constexpr auto describe = nimbDescribe;
    static constexpr auto carry = nimbCarry;
    static std::span<std::wstring> texts(NimbRecord& rec) { return rec.lines; }
    static constexpr std::size_t textLimit = nimbLineLength;
};

/// A web read from a NIMB file.
class PhotoWebNIMB final : public PhotoWebOf<PhotoWebNIMB, NimbFormat> {};

using PhotoWebNIMBPersistant = PhotoWebPersistant<NimbFormat>;
using NIMBBuilder = PhotoWebBuilder<NimbFormat>;

}  // namespace OvPhotometrics
