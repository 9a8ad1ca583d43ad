#include <algorithm>
#include <limits>
#include <new>

#include "components/photo/lid/reportMessage.h"
#include "components/photo/tbt/tbt.h"
#include "components/photo/tbt/tbtTokenizer.h"

namespace OvPhotometrics {

namespace {

constexpr std::int32_t anyCount = std::numeric_limits<std::int32_t>::max();

/// What the current token is, for people; empty where that is too long to show.
std::wstring description(const Report& report, const TbtTokenizer& in) {
    constexpr std::size_t longest = 63;
    std::wstring text;
    switch (in.kind()) {
        case TbtToken::number:
            text = report.text(messages::tbtTokenNumber, in.text());
            break;
        case TbtToken::zeroFill:
            text = report.text(messages::tbtTokenZeroFill, in.text());
            break;
        case TbtToken::end:
            text = report.text(messages::tbtTokenEnd, in.text());
            break;
        case TbtToken::endOfFile:
            text = report.text(messages::tbtTokenEndOfFile);
            break;
        case TbtToken::other:
            text = report.text(messages::tbtTokenOther, in.text());
            break;
    }
    return text.size() <= longest ? text : std::wstring();
}

/// Something else stands where a number, fill or end marker must stand.
bool syntaxError(const TbtTokenizer& in, Ov::Message<> message) {
    const Report report;
    const std::wstring detail = report.text(message);
    report.postWrapped(detail, messages::tbtSyntaxError, in.lineFeeds(), detail, description(report, in));
    return false;
}

template <class... Types>
bool valueError(const TbtTokenizer& in, Ov::Message<Types...> message, Ov::ArgumentFor<Types>... values) {
    const Report report;
    const std::wstring detail = report.text(message, values...);
    report.postWrapped(detail, messages::tbtValueError, in.lineFeeds(), detail);
    return false;
}

bool outOfMemory() {
    const Report report;
    report.postWrapped(report.text(messages::outOfMemory), messages::tbtResourceError,
                       static_cast<int>(messages::outOfMemory));
    return false;
}

bool readFloat(TbtTokenizer& in, float& value, Ov::Message<> missing) {
    in.next();
    return in.number(value) || syntaxError(in, missing);
}

bool readInteger(TbtTokenizer& in, std::int32_t& value, Ov::Message<> missing, std::int32_t least,
                 std::int32_t most, Ov::Message<int> wrong) {
    if (in.next() != TbtToken::number) return syntaxError(in, missing);
    return (in.integer(value) && value >= least && value <= most) || valueError(in, wrong, value);
}

bool readKind(TbtTokenizer& in, TbtFileRecord& rec) {
    if (!readInteger(in, rec.kindCode, messages::tbtKindCodeMissing, 3, 6, messages::tbtKindCode)) return false;
    switch (rec.kindCode) {
        case 4:
            return readFloat(in, rec.kindValue1, messages::tbtKind4Value);
        case 5:
            return readFloat(in, rec.kindValue1, messages::tbtKind5First) &&
                   readFloat(in, rec.kindValue2, messages::tbtKind5Second);
        case 6:
            return readFloat(in, rec.kindValue1, messages::tbtKind6Value);
        default:
            return true;
    }
}

bool readTriple(TbtTokenizer& in, std::array<float, 3>& triple) {
    for (float& value : triple)
        if (!readFloat(in, value, messages::tbtTripleMissing)) return false;
    return std::all_of(triple.begin(), triple.end(), [](float value) { return value >= 0 && value <= 1; }) ||
           valueError(in, messages::tbtTripleRange, triple[0], triple[1], triple[2]);
}

bool readScalars(TbtTokenizer& in, TbtFileRecord& rec) {
    if (!readFloat(in, rec.flux, messages::tbtFluxMissing)) return false;
    if (rec.flux < 0) return valueError(in, messages::tbtFlux, rec.flux);
    if (!readFloat(in, rec.referenceFlux, messages::tbtReferenceFluxMissing)) return false;
    if (rec.referenceFlux <= 0) return valueError(in, messages::tbtReferenceFlux, rec.referenceFlux);
    return readFloat(in, rec.multiplier, messages::tbtMultiplierMissing) &&
           readFloat(in, rec.auxValue1, messages::tbtAuxValue1Missing) &&
           readFloat(in, rec.auxValue2, messages::tbtAuxValue2Missing) &&
           readFloat(in, rec.auxValue3, messages::tbtAuxValue3Missing);
}

bool readGridSizes(TbtTokenizer& in, TbtFileRecord& rec) {
    if (!readInteger(in, rec.symmetryCode, messages::tbtSymmetryCodeMissing, 1, 4, messages::tbtSymmetryCode) ||
        !readInteger(in, rec.verticalCount, messages::tbtVerticalCountMissing, 2, anyCount,
                     messages::tbtVerticalCount))
        return false;
    const bool axial = rec.symmetryCode == 1;
    return readInteger(in, rec.horizontalCount, messages::tbtHorizontalCountMissing, axial ? 1 : 2,
                       axial ? 1 : anyCount, messages::tbtHorizontalCount);
}

/// Reads values until there are `end`, the last of a row.
bool readRow(TbtTokenizer& in, std::size_t end, std::vector<float>& values) {
    float value = 0;
    while (values.size() < end) {
        if (in.next() == TbtToken::zeroFill)
            values.resize(end);
        else if (in.number(value))
            values.push_back(value);
        else
            return syntaxError(in, messages::tbtValueMissing);
    }
    return true;
}

bool readValues(TbtTokenizer& in, TbtFileRecord& rec) {
    // A zero fill lets a few characters stand for a row of any length.
    if (std::int64_t{rec.verticalCount} * rec.horizontalCount > tbtMostValues) return outOfMemory();
    const auto row = static_cast<std::size_t>(rec.verticalCount);
    for (std::size_t end = row; end <= row * static_cast<std::size_t>(rec.horizontalCount); end += row)
        if (!readRow(in, end, rec.values)) return false;
    return true;
}

bool readFile(TbtTokenizer& in, TbtFileRecord& rec) {
    rec.title = in.readTitle().c_str();  // a NUL ends it
    return readKind(in, rec) && readTriple(in, rec.unitTriple) && readScalars(in, rec) && readGridSizes(in, rec) &&
           readValues(in, rec) && (in.next() == TbtToken::end || syntaxError(in, messages::tbtEndMissing));
}

}  // namespace

bool tbtRead(TbtFileRecord& rec, Ov::RnStream& in) {
    rec = TbtFileRecord();
    try {
        TbtTokenizer tokens(in);
        if (readFile(tokens, rec)) return true;
    } catch (const std::bad_alloc&) {
        outOfMemory();
    }
    rec.values = {};
    return false;
}

bool tbtCanRead(Ov::RnBufferedIO& io) {
    const long start = io.seek(0, 1);
    Ov::RnStream stream(&io, Ov::RnStream::Form::text);
    TbtTokenizer in(stream);
    in.readTitle();
    std::int32_t code = 0;
    const bool accepted = in.next() == TbtToken::number && in.integer(code) && tbtKindValues(code) >= 0;
    io.seek(start, 0);
    return accepted;
}

}  // namespace OvPhotometrics
