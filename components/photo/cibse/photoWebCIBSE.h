#pragma once

#include "components/photo/cibse/cibse.h"
#include "components/photo/files/photoWebComponent.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

struct CibseFormat {
    using Web = PhotoWebCIBSE;
    using Record = CibseRecord;
    static constexpr BuilderInfo info{classIds::cibseWeb, photometricWebCategory, L"CIBSE Web",
                                      L"CIBSE Photometric Web"};
    static constexpr Ov::PhotoFormatTraits traits{.name = L"CIBSE", .preference = 100, .holdsOrientation = true};
    static constexpr const wchar_t* extension = L"cib";
    static constexpr const char* source = "components/photo/cibse/cibse";
    static constexpr int saveLine = 218;
    static constexpr int loadLine = 229;
    static constexpr const char* streamName = "CIBSE stream";

    static constexpr auto canImport = cibseCanRead;
    static constexpr auto read = cibseRead;
    static constexpr auto toWeb = cibseToWeb;
    static constexpr auto fromDistribution = cibseRecordFromDistribution;
    static constexpr auto write = cibseWrite;
    static constexpr auto fromDistributionFaithfully = cibseRecordFromDistributionFaithfully;
    static constexpr auto describe = cibseDescribe;
    static constexpr auto carry = cibseCarry;
};

/// A web read from a CIBSE file.
class PhotoWebCIBSE final : public PhotoWebOf<PhotoWebCIBSE, CibseFormat> {};

using PhotoWebCIBSEPersistant = PhotoWebPersistant<CibseFormat>;
using CIBSEBuilder = PhotoWebBuilder<CibseFormat>;

}  // namespace OvPhotometrics
