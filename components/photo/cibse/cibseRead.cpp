#include <span>

#include "components/messageFile/messageIds.h"
#include "components/photo/cibse/cibse.h"
#include "components/photo/files/numberText.h"
#include "components/photo/lid/withinMemory.h"

namespace OvPhotometrics {

namespace {

bool refuse(Ov::Message<> message) {
    reportParseMessage(message);
    return false;
}

/// No line at the end of the input counts as an empty one.
bool readLabels(CibseRecord& rec, Ov::RnStream& in) {
    constexpr const wchar_t* line = L"%60[^\r\n]";
    std::wstring first;
    readTextLine(in, line, first);
    if (!first.starts_with(cibseSignature)) return refuse(messages::cibseFirstLine);
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

}  // namespace

bool cibseRead(CibseRecord& rec, Ov::RnStream& in) {
    rec = CibseRecord();
    if (withinMemory([&] { return readFile(rec, in); })) return true;
    rec = CibseRecord();
    return false;
}

bool cibseCanRead(Ov::RnBufferedIO& io) { return matchesAt(io, cibseSignature); }

}  // namespace OvPhotometrics
