#include <algorithm>
#include <cmath>
#include <string_view>

#include "components/photo/files/numberText.h"
#include "components/photo/tbt/tbt.h"
#include "components/support/textClass.h"

namespace OvPhotometrics {

namespace {

/// Rounds to two decimals, or as many as give six digits: those of another file are found again behind single
/// precision.
float roundedToSixDigits(float value) {
    if (!(value > 0)) return 0;  // a negative zero would have a sign
    if (!std::isfinite(value)) return value;
    const double parts = std::pow(10, std::max(2.0, 5 - std::floor(std::log10(double{value}))));
    return static_cast<float>(std::round(value * parts) / parts);
}

/// Writes a row up to its last value that is not 0, but at least one; the zeros behind it in short.
void writeRow(const float* row, int count, Ov::RnStream& out, FileForm form) {
    constexpr int fullLine = 68;  // a line of more characters takes no further value
    int written = count;
    while (written > 1 && row[written - 1] == 0) --written;
    std::wstring item;
    int length = 0;
    for (int v = 0; v < written; ++v) {
        if (length > fullLine) {
            endLine(out);
            length = 0;
        }
        item.assign(1, L' ');
        appendNumber(item, form == FileForm::faithful ? roundedToSixDigits(row[v]) : row[v], form, 2);
        const int width = static_cast<int>(item.size());
        writeItem(out, item.data(), width);
        length += width;
    }
    const int zeros = count - written;
    writeLine(out, zeros == 0 ? L"" : zeros == 1 ? L" 0." : L" Z0");
}

void writeKind(const TbtFileRecord& rec, Ov::RnStream& out, FileForm form) {
    writeLine(out, L"%d", rec.kindCode);
    const int values = tbtKindValues(rec.kindCode);
    if (values == 1) out.formattedWrite(L"%s  ", numbersText({rec.kindValue1}, form).c_str());
    if (values == 2) out.formattedWrite(L"%s  ", numbersText({rec.kindValue1, rec.kindValue2}, form).c_str());
    const auto& [first, second, third] = rec.unitTriple;
    writeLine(out, L"%s", numbersText({first, second, third}, form, 4).c_str());
}

}  // namespace

bool tbtWrite(const TbtFileRecord& rec, Ov::RnStream& out, FileForm form) {
    writeLine(out, L"%s", rec.title.c_str());
    writeKind(rec, out, form);
    writeLine(out, L"%s %s", numbersText({rec.flux, rec.referenceFlux}, form, 2).c_str(),
              numbersText({rec.multiplier, rec.auxValue1, rec.auxValue2, rec.auxValue3}, form).c_str());
    writeLine(out, L"%d %d %d", rec.symmetryCode, rec.verticalCount, rec.horizontalCount);
    const float* row = rec.values.data();
    for (int h = 0; h < rec.horizontalCount; ++h, row += rec.verticalCount)
        writeRow(row, rec.verticalCount, out, form);
    writeLine(out, L"-1");
    return true;
}

}  // namespace OvPhotometrics
