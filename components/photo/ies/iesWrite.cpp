#include "components/photo/files/ownGrid.h"
#include "components/photo/files/webDistribution.h"
#include "components/photo/ies/ies.h"
#include "components/photo/lid/withinMemory.h"

namespace OvPhotometrics {

namespace {

constexpr int valueLineLimit = 133;  // no value line reaches this many characters

void writeValues(const std::vector<float>& values, Ov::RnStream& out, FileForm form) {
    writeValueList(values.size(), values.data(), out, valueLineLimit, form);
}

void writeTilt(const IesFileRecord& rec, Ov::RnStream& out, FileForm form) {
    switch (rec.tiltKind) {
        case IesTiltKind::none:
            writeLine(out, L"TILT=NONE");
            break;
        case IesTiltKind::include:
            writeLine(out, L"TILT=INCLUDE");
            writeLine(out, L" %d", rec.tilt.geometry);
            writeLine(out, L" %d", static_cast<int>(rec.tilt.tiltAngles.size()));
            writeValues(rec.tilt.tiltAngles, out, form);
            writeValues(rec.tilt.tiltFactors, out, form);
            break;
        case IesTiltKind::file:
            writeLine(out, L"TILT=%*s", 75, rec.tiltFile.c_str());
            break;
    }
}

}  // namespace

bool iesRecordInitForWriting(IesFileRecord& rec) {
    return withinMemory([&] {
        rec = IesFileRecord();
        rec.lines = {L"IESNA91", L"[TEST]     Test unknown", L"[MANUFAC]  Manufacturing company unknown"};
        return true;
    });
}

bool iesRecordFromDistribution(Ov::RnIntensityDist& dist, IesFileRecord& rec) {
    const auto web = webOf(dist);
    const GridFit fit = web ? gridFit(*web) : GridFit::none;
    if (fit == GridFit::none) return iesRecordFromSampling(dist, rec);
    if (!iesRecordInitForWriting(rec) || !candelaGridFromWeb(rec.grid, *web, fit, 1)) return false;
    rec.photometricType = fit == GridFit::polar ? IesPhotometricType::C : IesPhotometricType::A;
    rec.lumensPerLamp = web->getLumens();
    return true;
}

bool iesRecordFromSampling(Ov::RnIntensityDist& dist, IesFileRecord& rec) {
    if (!iesRecordInitForWriting(rec)) return false;
    if (!candelaGridFromSampling(rec.grid, dist, LastPlane::without, 1)) return false;
    rec.lumensPerLamp = dist.getFlux();
    return true;
}

bool iesRecordFromDistributionFaithfully(Ov::RnIntensityDist& dist, IesFileRecord& rec) {
    constexpr OwnGridRules rules{
        .tolerance = iesTolerance, .wraps = false, .lateralTruncated = true, .uprightTurned = true};
    if (!iesRecordInitForWriting(rec)) return false;
    FileGrid file = faithfulGrid(dist, rules);
    rec.photometricType = file.frame == GridFrame::polar     ? IesPhotometricType::C
                          : file.frame == GridFrame::upright ? IesPhotometricType::A
                                                             : IesPhotometricType::B;
    rec.grid = std::move(file.grid);
    rec.candelaMultiplier = scaleForFile(rec.grid, 1);
    if (const float flux = dist.getFlux(); flux > 0) rec.lumensPerLamp = flux;
    return true;
}

bool iesWriteRecord(const IesFileRecord& rec, Ov::RnStream& out, FileForm form) {
    const CandelaGrid& grid = rec.grid;
    const bool real = grid.verticalCount >= 2 && grid.horizontalCount >= 1;
    for (const std::wstring& line : rec.lines) writeLine(out, L"%s", line.c_str());
    writeTilt(rec, out, form);
    writeLine(out, L"%d %s %s", rec.lampCount, numbersText({rec.lumensPerLamp}, form, 2).c_str(),
              numbersText({rec.candelaMultiplier}, form).c_str());
    writeLine(out, L"%d %d", real ? grid.verticalCount : 2, real ? grid.horizontalCount : 1);
    writeLine(out, L"%d", static_cast<int>(rec.photometricType));
    writeLine(out, L"%d", rec.unitsType);
    writeLine(out, L"%s", numbersText({rec.width, rec.length, rec.height}, form).c_str());
    writeLine(out, L"%s", numbersText({rec.ballastFactor, rec.ballastLampFactor, rec.inputWatts}, form).c_str());
    if (real) {
        candelaGridWrite(grid, out, valueLineLimit, form);
    } else {
        for (const wchar_t* line : {L"0.0 180.0", L"0.0", L"0.0 0.0"}) writeLine(out, L"%s", line);
    }
    return true;
}

}  // namespace OvPhotometrics
