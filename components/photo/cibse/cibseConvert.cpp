#include "components/messageFile/messageIds.h"
#include "components/photo/cibse/photoWebCIBSE.h"
#include "components/photo/files/gridLayout.h"
#include "components/photo/files/ownGrid.h"
#include "components/photo/lid/withinMemory.h"

namespace OvPhotometrics {

namespace {

constexpr PolarRules type1{cibseTolerance, messages::cibseType1VerticalRange,
                           messages::cibseType1LastHorizontalAngle, messages::cibseType1FirstHorizontalAngle,
                           true};
constexpr LateralRules type2{cibseTolerance, messages::cibseType2VerticalRange,
                             messages::cibseType2HorizontalCount, messages::cibseType2HorizontalRange};

bool isType1(const CibseRecord& rec) { return rec.photometricType == CibsePhotometricType::type1; }

bool install(const CibseRecord& rec, const WebLayout& layout, PhotoWebCIBSE& web, bool loaded,
             const wchar_t* name) {
    if (layout.columns == 0) return false;  // 270 alone: a last plane that repeats itself
    PhotoWebRecord webRecord;
    photoWebRecordInit(webRecord, rec.grid.verticalCount, layout.columns, layout.symmetry, false, loaded, name);
    fillWebRecord(webRecord, rec.grid, layout, rec.factors[0]);
    if (layout.horizontalShift != 0)
        photoWebRecordSetOrientation(webRecord, isType1(rec) ? turnedBy(layout.horizontalShift)
                                                             : laidDownBy(layout.horizontalShift, -halfPi));
    return photoWebInstall(web, webRecord);
}

}  // namespace

bool cibseToWeb(const CibseRecord& rec, PhotoWebCIBSE& web, bool loaded, const wchar_t* name) {
    WebLayout layout;
    if (!(isType1(rec) ? polarLayout(rec.grid, type1, layout) : lateralLayout(rec.grid, type2, layout)))
        return false;
    return installOrReport([&] { return install(rec, layout, web, loaded, name); });
}

bool cibseRecordFromDistribution(Ov::RnIntensityDist& dist, CibseRecord& rec) {
    const float flux = dist.getFlux();
    const float scale = flux > 0 ? static_cast<float>(1000.0 / flux) : 0;
    const auto web = webOf(dist);
    const GridFit fit = web ? gridFit(*web) : GridFit::none;
    if (fit == GridFit::none) return cibseResample(dist, rec, scale);
    rec = CibseRecord();
    rec.photometricType = fit == GridFit::polar ? CibsePhotometricType::type1 : CibsePhotometricType::type2;
    return candelaGridFromWeb(rec.grid, *web, fit, scale);
}

bool cibseResample(Ov::RnIntensityDist& dist, CibseRecord& rec, float scale) {
    rec = CibseRecord();
    return candelaGridFromSampling(rec.grid, dist, LastPlane::with, scale);
}

bool cibseRecordFromDistributionFaithfully(Ov::RnIntensityDist& dist, CibseRecord& rec) {
    constexpr OwnGridRules rules{
        .tolerance = cibseTolerance, .wraps = true, .lateralTruncated = false, .uprightTurned = false};
    rec = CibseRecord();
    FileGrid file = faithfulGrid(dist, rules);
    rec.photometricType =
        file.frame == GridFrame::polar ? CibsePhotometricType::type1 : CibsePhotometricType::type2;
    rec.grid = std::move(file.grid);
    const float flux = dist.getFlux();
    rec.factors[0] = scaleForFile(rec.grid, flux > 0 ? 1000.0 / flux : 1);
    return true;
}

}  // namespace OvPhotometrics
