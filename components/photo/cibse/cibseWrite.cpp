#include "components/photo/cibse/cibse.h"
#include "components/photo/files/numberText.h"

namespace OvPhotometrics {

bool cibseWrite(const CibseRecord& rec, Ov::RnStream& out, FileForm form) {
    const auto three = [&](const std::array<float, 3>& v) { return numbersText({v[0], v[1], v[2]}, form); };
    writeLine(out, L"%s", cibseSignature);
    for (const std::wstring& label : rec.labels)
        writeLine(out, L"%s", label.empty() ? L" " : labelText(label, cibseLabelLimit).c_str());
    writeLine(out, L"%d %d %s", rec.leadInteger, static_cast<int>(rec.photometricType),
              three(rec.leadValues).c_str());
    writeLine(out, L"%s", three(rec.factors).c_str());
    writeLine(out, L"%s", numbersText({rec.singleValue}, form, 2).c_str());
    writeLine(out, L"%d %d", rec.grid.verticalCount, rec.grid.horizontalCount);
    constexpr int valueLineLimit = 79;  // no value line reaches this many characters
    candelaGridWrite(rec.grid, out, valueLineLimit, form);
    writeLine(out, L"%d %s", rec.trailerInteger, three(rec.trailerValues).c_str());
    return true;
}

}  // namespace OvPhotometrics
