#include "components/messageFile/messageIds.h"
#include "components/photo/files/gridLayout.h"
#include "components/photo/ies/ies.h"
#include "components/photo/ies/photoWebIES.h"
#include "components/photo/lid/withinMemory.h"

namespace OvPhotometrics {

namespace {

constexpr PolarRules typeC{iesTolerance, messages::typeCVerticalRange, messages::typeCLastHorizontalAngle,
                           messages::typeCFirstHorizontalAngle};
constexpr LateralRules typeB{iesTolerance, messages::typeBVerticalRange, messages::typeBHorizontalCount,
                             messages::typeBHorizontalRange};
constexpr LateralRules typeA{iesTolerance, messages::typeAVerticalRange, messages::typeAHorizontalCount,
                             messages::typeAHorizontalRange};

bool chooseLayout(const IesFileRecord& rec, WebLayout& layout) {
    if (rec.photometricType == IesPhotometricType::C) return polarLayout(rec.grid, typeC, layout);
    if (!lateralLayout(rec.grid, rec.photometricType == IesPhotometricType::B ? typeB : typeA, layout))
        return false;
    layout.psiTruncated = true;
    return true;
}

bool install(const IesFileRecord& rec, const WebLayout& layout, PhotoWebIES& web, bool loaded, const wchar_t* name,
             const wchar_t* basePath) {
    IesWebRecord webRecord;
    const std::wstring tiltPath = rec.tiltFile.empty() ? std::wstring() : iesFindTiltFile(rec.tiltFile, basePath);
    iesWebRecordInit(webRecord, rec.grid.verticalCount, layout.columns, layout.symmetry, layout.psiTruncated,
                     loaded, name, rec.tiltFile.c_str(), tiltPath.c_str());
    fillWebRecord(webRecord, rec.grid, layout, rec.candelaMultiplier * rec.ballastFactor * rec.ballastLampFactor);
    photoWebRecordSetLumens(webRecord,
                            rec.lumensPerLamp < 0 ? -1 : static_cast<float>(rec.lampCount) * rec.lumensPerLamp);
    if (layout.horizontalShift != 0)
        photoWebRecordSetOrientation(webRecord, rec.photometricType == IesPhotometricType::B
                                                    ? laidDownBy(layout.horizontalShift)
                                                    : turnedBy(layout.horizontalShift));
    return web.installIesRecord(webRecord);
}

}  // namespace

bool iesRecordToWeb(const IesFileRecord& rec, PhotoWebIES& web, bool loaded, const wchar_t* name,
                    const wchar_t* basePath) {
    WebLayout layout;
    if (!chooseLayout(rec, layout)) return false;
    return installOrReport([&] { return install(rec, layout, web, loaded, name, basePath); });
}

}  // namespace OvPhotometrics
