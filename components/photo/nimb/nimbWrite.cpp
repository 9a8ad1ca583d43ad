#include <algorithm>
#include <exception>
#include <string_view>

#include "components/messageFile/messageIds.h"
#include "components/photo/files/numberText.h"
#include "components/photo/lid/reportMessage.h"
#include "components/photo/nimb/nimb.h"

namespace OvPhotometrics {

namespace {

bool headerFits(const NimbRecord& rec) {
    const std::int32_t numbers[] = {rec.psiMax,
                                    rec.thetaMax,
                                    rec.psiStep,
                                    rec.thetaStep,
                                    rec.orientationAngle,
                                    rec.spare1,
                                    rec.spare2,
                                    rec.spare3,
                                    std::max(rec.symmetryCode1, 0),
                                    std::max(rec.symmetryCode2, 0)};
    return nimbFitsIdentifier(rec.identifier) &&
           std::all_of(std::begin(numbers), std::end(numbers), nimbFitsField);
}

/// A number, or as many blanks where there is none.
void writeField(Ov::RnStream& s, bool present, int width, std::int32_t number) {
    if (present)
        s.formattedWrite(L"%*d", width, number);
    else
        s.formattedWrite(L"%*s", width, L" ");
}

void writeHeader(const NimbRecord& rec, Ov::RnStream& s) {
    const bool large = rec.identifier > nimbLargestField;
    s.formattedWrite(L"%4d", large ? -1 : rec.identifier);
    s.formattedWrite(L"%4d%4d%4d%4d%4d%4d%4d%4dNIMB", rec.psiMax, rec.thetaMax, rec.psiStep, rec.thetaStep,
                     rec.orientationAngle, rec.spare1, rec.spare2, rec.spare3);
    writeField(s, large, 8, rec.identifier);
    writeField(s, rec.symmetryCode1 >= 0, 4, rec.symmetryCode1);
    writeField(s, rec.symmetryCode2 >= 0, 4, rec.symmetryCode2);
    endLine(s);
}

void writeText(std::wstring line, Ov::RnStream& s) {
    line.resize(std::min<std::size_t>(line.size(), nimbLineLength));
    std::replace_if(
        line.begin(), line.end(), [](wchar_t c) { return c == L'\n' || c == L'\r'; }, L' ');
    writeLine(s, L"%s", line.c_str());
}

void writeValues(const std::vector<std::int16_t>& values, Ov::RnStream& s) {
    for (std::size_t k = 0; k < values.size(); ++k) {
        if (k > 0 && k % nimbValuesPerLine == 0) endLine(s);
        s.formattedWrite(L"%4d", std::clamp<int>(values[k], -999, nimbLargestField));
    }
    endLine(s);
}

}  // namespace

bool nimbWrite(const NimbRecord& rec, Ov::RnStream& s) {
    try {
        if (headerFits(rec)) {
            writeHeader(rec, s);
            for (const std::wstring& line : rec.lines) writeText(line, s);
            writeValues(rec.values, s);
            return true;
        }
    } catch (const std::exception&) {
    }
    reportMessage(messages::nimbNotWritten);
    return false;
}

}  // namespace OvPhotometrics
