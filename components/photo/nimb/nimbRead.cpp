#include <algorithm>
#include <array>
#include <cstring>
#include <string_view>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/withinMemory.h"
#include "components/photo/nimb/nimb.h"
#include "components/support/streamText.h"

namespace OvPhotometrics {

namespace {

constexpr std::size_t fieldWidth = 4;
constexpr int magicPlace = 36;

/// A file being read, line by line: the current one, cut into fields.
class Lines {
public:
    explicit Lines(Ov::RnStream& in) : _in(in) {}

    /// Reads the next line. False, after a message, at the end of the input.
    bool next() {
        ++_number;
        const int length = nimbReadLine(_buffer.data(), _in);
        if (length < 0) return refuse(messages::nimbEndOfFile);
        _text = {_buffer.data(), static_cast<std::size_t>(length)};
        return true;
    }

    /// Reports what is wrong with the current line; false.
    template <class... Types>
    bool refuse(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) const {
        const Report report;
        const std::wstring detail = report.text(message, arguments...);
        report.postWrapped(detail, messages::nimbLine, _number, detail);
        return false;
    }

    std::wstring_view text() const { return _text; }
    int fields() const { return static_cast<int>(_text.size() / fieldWidth); }
    /// The number at the right of a field: -1 for blanks alone, else the digits behind whatever else there is,
    /// negative behind a minus sign.
    int field(int index) const {
        const std::wstring_view field = _text.substr(static_cast<std::size_t>(index) * fieldWidth, fieldWidth);
        int value = 0;
        int unit = 1;
        for (std::size_t k = field.size(); k-- > 0; unit *= 10) {
            const wchar_t c = field[k];
            if (c == L'-') return -value;
            if (c == L' ' && unit == 1) return -1;
            if (c < L'0' || c > L'9') return value;
            value += static_cast<int>(c - L'0') * unit;
        }
        return value;
    }

private:
    Ov::RnStream& _in;
    int _number = 0;
    std::array<wchar_t, nimbLineLength + 1> _buffer{};
    std::wstring_view _text;
};

bool readHeader(NimbRecord& rec, Lines& lines) {
    if (!lines.next()) return false;
    const int fields = lines.fields();
    if (fields < 10) return lines.refuse(messages::nimbHeaderFields, fields);
    if (lines.text().substr(magicPlace, 4) != L"NIMB") return lines.refuse(messages::nimbMagic);

    rec.identifier = lines.field(0);
    if (rec.identifier < 0) rec.identifier = fields >= 12 ? lines.field(10) * 10000 + lines.field(11) : 0;
    int next = 1;
    for (std::int32_t* number : {&rec.psiMax, &rec.thetaMax, &rec.psiStep, &rec.thetaStep, &rec.orientationAngle,
                                 &rec.spare1, &rec.spare2, &rec.spare3})
        *number = lines.field(next++);
    rec.symmetryCode1 = fields >= 13 ? lines.field(12) : -1;
    rec.symmetryCode2 = fields >= 14 ? lines.field(13) : -1;
    return true;
}

bool readTextLines(NimbRecord& rec, Lines& lines) {
    for (std::wstring& text : rec.lines) {
        if (!lines.next()) return false;
        text = lines.text();
    }
    return true;
}

bool dividesRightAngle(int step) { return step > 0 && 90 % step == 0; }
bool isSymmetryCode(int code) { return code >= -1 && code <= 3; }

bool checkHeader(const NimbRecord& rec, const Lines& lines) {
    const struct {
        bool valid;
        Ov::Message<int> message;
        std::int32_t value;
    } checks[] = {
        {rec.psiMax == 0 || rec.psiMax == 90 || rec.psiMax == 180 || rec.psiMax == 360 - rec.psiStep,
         messages::nimbLastHorizontalAngle, rec.psiMax},
        {rec.thetaMax >= 90 && rec.thetaMax <= 180, messages::nimbLastVerticalAngle, rec.thetaMax},
        {dividesRightAngle(rec.psiStep), messages::nimbHorizontalStep, rec.psiStep},
        {dividesRightAngle(rec.thetaStep), messages::nimbVerticalStep, rec.thetaStep},
        {rec.orientationAngle % 90 == 0 && rec.orientationAngle >= -180 && rec.orientationAngle <= 180,
         messages::nimbOrientation, rec.orientationAngle},
        {isSymmetryCode(rec.symmetryCode1), messages::nimbSymmetryCode1, rec.symmetryCode1},
        {isSymmetryCode(rec.symmetryCode2), messages::nimbSymmetryCode2, rec.symmetryCode2},
    };
    for (const auto& check : checks)
        if (!check.valid) return lines.refuse(check.message, check.value);
    return true;
}

bool readValues(NimbRecord& rec, Lines& lines) {
    const int count = rec.valueCount();
    rec.values.reserve(static_cast<std::size_t>(count));
    for (int done = 0; done < count; done += nimbValuesPerLine) {
        if (!lines.next()) return false;
        const int expected = std::min(count - done, nimbValuesPerLine);
        if (lines.fields() != expected) return lines.refuse(messages::nimbLineFields, lines.fields());
        for (int k = 0; k < expected; ++k) rec.values.push_back(static_cast<std::int16_t>(lines.field(k)));
    }
    return true;
}

}  // namespace

bool nimbCanRead(Ov::RnBufferedIO& io) {
    const long start = io.seek(0, 1);
    char bytes[nimbLineLength];
    const bool enough = Ov::rnReadBytes(io, bytes, sizeof bytes) == static_cast<int>(sizeof bytes);
    io.seek(start, 0);
    return enough && std::memcmp(bytes + magicPlace, "NIMB", 4) == 0;
}

int nimbReadLine(wchar_t* buffer73, Ov::RnStream& s) {
    int length = 0;
    bool isThere = false;
    Ov::RnStreamInput chars(s);
    Ov::RnCharInput& in = chars.chars();
    in.takeWhile([&](int c) {
        isThere = true;
        const bool ends = c == '\n' || c == '\r';
        if (!ends && length < nimbLineLength) buffer73[length++] = static_cast<wchar_t>(c);
        return !ends;
    });
    if (!isThere) return -1;
    if (in.getChar() == '\r') {
        const int after = in.getChar();
        if (after != '\n') in.ungetChar(after);
    }
    buffer73[length] = 0;
    return length;
}

bool nimbRead(NimbRecord& rec, Ov::RnStream& s) {
    rec = NimbRecord();
    Lines lines(s);
    if (withinMemory([&] {
            return readHeader(rec, lines) && readTextLines(rec, lines) && checkHeader(rec, lines) &&
                   readValues(rec, lines);
        }))
        return true;
    rec = NimbRecord();
    return false;
}

}  // namespace OvPhotometrics
