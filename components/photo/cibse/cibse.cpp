#include "components/photo/cibse/cibse.h"

#include <span>

#include "components/messageFile/messageIds.h"
#include "components/photo/cibse/photoWebCIBSE.h"
#include "components/photo/files/gridLayout.h"
#include "components/photo/files/ownGrid.h"
#include "components/photo/lid/withinMemory.h"

namespace OvPhotometrics {

namespace {

constexpr const wchar_t* signature = L"CIBSE/1";
constexpr int valueLineLimit = 79;  // no value line reaches this many characters

constexpr PolarRules type1{cibseTolerance, messages::cibseType1VerticalRange,
                           messages::cibseType1LastHorizontalAngle, messages::cibseType1FirstHorizontalAngle,
                           true};
constexpr LateralRules type2{cibseTolerance, messages::cibseType2VerticalRange,
                             messages::cibseType2HorizontalCount, messages::cibseType2HorizontalRange};

bool refuse(Ov::Message<> message) {
    reportParseMessage(message);
    return false;
}

/// No line at the end of the input counts as an empty one.
bool readLabels(CibseRecord& rec, Ov::RnStream& in) {
    constexpr const wchar_t* line = L"%60[^\r\n]";
    std::wstring first;
    readTextLine(in, line, first);
    if (!first.starts_with(signature)) return refuse(messages::cibseFirstLine);
    for (std::wstring& label : rec.labels) readTextLine(in, line, label);
    return true;
}

bool readGroup(NumberText& in, std::span<float> values, Ov::Message<> failure) {
    for (float& value : values) in.readFloat(value);
    return !in.failed() || refuse(failure);
}

bool readNumbers(CibseRecord& rec, NumberText& in) {
    if (!in.readInteger(rec.leadInteger, messages::lampCount, 1)) return false;
    std::int32_t type = 0;
    if (!in.readInteger(type, messages::photometricType, 1, 2)) return false;
    rec.photometricType = static_cast<CibsePhotometricType>(type);
    if (!readGroup(in, rec.leadValues, messages::dimensions) || !readGroup(in, rec.factors, messages::factors) ||
        !readGroup(in, std::span(&rec.singleValue, 1), messages::cibseNinthNumber))
        return false;
    if (!candelaGridReadCounts(rec.grid, in) || !candelaGridRead(rec.grid, in)) return false;
    in.readInteger(rec.trailerInteger);
    return readGroup(in, rec.trailerValues, messages::cibseTrailer);
}

bool readFile(CibseRecord& rec, Ov::RnStream& in) {
    if (!readLabels(rec, in)) return false;
    NumberText numbers(in, NumberText::AtEnd::unexpectedBlank);
    return readNumbers(rec, numbers);
}

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

bool cibseRead(CibseRecord& rec, Ov::RnStream& in) {
    rec = CibseRecord();
    if (withinMemory([&] { return readFile(rec, in); })) return true;
    rec = CibseRecord();
    return false;
}

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

bool cibseWrite(const CibseRecord& rec, Ov::RnStream& out, FileForm form) {
    const auto three = [&](const std::array<float, 3>& v) { return numbersText({v[0], v[1], v[2]}, form); };
    writeLine(out, L"%s", signature);
    for (const std::wstring& label : rec.labels)
        writeLine(out, L"%s", label.empty() ? L" " : labelText(label, cibseLabelLimit).c_str());
    writeLine(out, L"%d %d %s", rec.leadInteger, static_cast<int>(rec.photometricType),
              three(rec.leadValues).c_str());
    writeLine(out, L"%s", three(rec.factors).c_str());
    writeLine(out, L"%s", numbersText({rec.singleValue}, form, 2).c_str());
    writeLine(out, L"%d %d", rec.grid.verticalCount, rec.grid.horizontalCount);
    candelaGridWrite(rec.grid, out, valueLineLimit, form);
    writeLine(out, L"%d %s", rec.trailerInteger, three(rec.trailerValues).c_str());
    return true;
}

bool cibseCanRead(Ov::RnBufferedIO& io) { return matchesAt(io, signature); }

}  // namespace OvPhotometrics
