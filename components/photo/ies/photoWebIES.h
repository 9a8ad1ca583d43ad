#pragma once

#include <string>

#include "components/photo/files/photoWebComponent.h"
#include "components/photo/ies/ies.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

struct IesFormat {
    using Web = PhotoWebIES;
    using Record = IesFileRecord;
    static constexpr BuilderInfo info{classIds::iesWeb, photometricWebCategory, L"IES Web",
                                      L"IES Photometric Web"};
    static constexpr Ov::PhotoFormatTraits traits{
        .name = L"IES", .preference = 200, .holdsLampLumens = true, .holdsOrientation = true};
    static constexpr const wchar_t* extension = L"ies";
    static constexpr const char* source = "components/photo/ies/ies";
    static constexpr int saveLine = 246;
    static constexpr int loadLine = 257;
    static constexpr const char* streamName = "IES stream";

    static constexpr auto canImport = iesCanRead;
    static constexpr auto read = iesReadRecord;
    static constexpr auto toWeb = iesRecordToWeb;
    static constexpr auto fromDistribution = iesRecordFromDistribution;
    static constexpr auto write = iesWriteRecord;
    static constexpr auto fromDistributionFaithfully = iesRecordFromDistributionFaithfully;
    static constexpr auto describe = iesDescribe;
    static constexpr auto carry = iesCarry;
};

/// A web record with the tilt file that the web depends on.
struct IesWebRecord : PhotoWebRecord {
    std::wstring tiltFile;  // as written behind "TILT="; empty without one
    std::wstring tiltPath;  // where it was found
};

/// As `photoWebRecordInit`; null strings count as empty.
void iesWebRecordInit(IesWebRecord& rec, int nthetas, int npsis, PhotoWebSymmetry symmetry, bool psiTruncated,
                      bool loaded, const wchar_t* name, const wchar_t* tiltFile, const wchar_t* tiltPath);

/// A web read from an IES file.
class PhotoWebIES final : public PhotoWebOf<PhotoWebIES, IesFormat> {
public:
    /// Visits the path of the tilt file, if there is one.
    RnEnum::Action enumerateFiles(Ov::RnEnumerator<const wchar_t*>& visitor) const override;

    /// As `photoWebInstall`, the tilt file included.
    bool installIesRecord(const IesWebRecord& rec);

private:
    std::wstring _tiltFile;
    std::wstring _tiltPath;
};

using PhotoWebIESPersistant = PhotoWebPersistant<IesFormat>;
using IESBuilder = PhotoWebBuilder<IesFormat>;

}  // namespace OvPhotometrics
