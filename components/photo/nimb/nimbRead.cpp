#include <algorithm>
#include <array>
#include <cstring>
#include <string_view>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/withinMemory.h"
#include "components/photo/nimb/nimb.h"

namespace OvPhotometrics {

namespace {

constexpr std::size_t fieldWidth = 4;
constexpr int magicPlace = 36;
constexpr int valuesPerLine = 17;

int nimbLineNumber = 0;

/// Reports what is wrong with the current line; false.
template <class... Arguments>
bool nimbReportError(unsigned id, Arguments... arguments) {
    const std::wstring detail = messageText(id, arguments...);
    reportWrapped(detail, messages::nimbLine, nimbLineNumber, detail.c_str());
    return false;
}

/// One line as the reader keeps it, cut into fields.
class Line {
public:
    /// False, after a message, at the end of the input.
    bool read(Ov::RnStream& s) {
        const int length = nimbReadLine(_buffer.data(), s);
        if (length < 0) return nimbReportError(messages::nimbEndOfFile);
        _text = {_buffer.data(), static_cast<std::size_t>(length)};
        return true;
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
    std::array<wchar_t, nimbLineLength + 1> _buffer{};
    std::wstring_view _text;
};

bool readHeader(NimbRecord& rec, Ov::RnStream& s) {
    Line line;
    if (!line.read(s)) return false;
    const int fields = line.fields();
    if (fields < 10) return nimbReportError(messages::nimbHeaderFields, fields);
    if (line.text().substr(magicPlace, 4) != L"NIMB") return nimbReportError(messages::nimbMagic);

    rec.identifier = line.field(0);
    if (rec.identifier < 0) rec.identifier = fields >= 12 ? line.field(10) * 10000 + line.field(11) : 0;
    int next = 1;
    for (std::int32_t* number : {&rec.psiMax, &rec.thetaMax, &rec.psiStep, &rec.thetaStep, &rec.orientationAngle,
                                 &rec.spare1, &rec.spare2, &rec.spare3})
        *number = line.field(next++);
    rec.symmetryCode1 = fields >= 13 ? line.field(12) : -1;
    rec.symmetryCode2 = fields >= 14 ? line.field(13) : -1;
    return true;
}

bool readTextLines(NimbRecord& rec, Ov::RnStream& s) {
    Line line;
    for (std::wstring& text : rec.lines) {
        if (!line.read(s)) return false;
        text = line.text();
    }
    return true;
}

bool dividesRightAngle(int step) { return step > 0 && 90 % step == 0; }
bool isSymmetryCode(int code) { return code >= -1 && code <= 3; }

bool checkHeader(const NimbRecord& rec) {
    const struct {
        bool valid;
        unsigned message;
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
        if (!check.valid) return nimbReportError(check.message, check.value);
    return true;
}

bool readValues(NimbRecord& rec, Ov::RnStream& s) {
    const int count = rec.valueCount();
    rec.values.reserve(static_cast<std::size_t>(count));
    Line line;
    for (int done = 0; done < count; done += valuesPerLine) {
        if (!line.read(s)) return false;
        const int expected = std::min(count - done, valuesPerLine);
        if (line.fields() != expected) return nimbReportError(messages::nimbLineFields, line.fields());
        for (int k = 0; k < expected; ++k) rec.values.push_back(static_cast<std::int16_t>(line.field(k)));
    }
    return true;
}

}  // namespace

bool nimbCanRead(Ov::RnBufferedIO& io) {
    const long start = io.seek(0, 1);
    char bytes[nimbLineLength];
    const bool enough = io.readBytes(bytes, sizeof bytes) == static_cast<int>(sizeof bytes);
    io.seek(start, 0);
    return enough && std::memcmp(bytes + magicPlace, "NIMB", 4) == 0;
}

int nimbReadLine(wchar_t* buffer73, Ov::RnStream& s) {
    ++nimbLineNumber;
    int c = s.getChar();
    if (c < 0) return -1;
    int length = 0;
    const auto ends = [](int character) { return character < 0 || character == '\n' || character == '\r'; };
    Ov::RnBufferedIO& device = s.device();
    while (!ends(c)) {
        if (length < nimbLineLength) buffer73[length++] = static_cast<wchar_t>(c);
        // What the device holds ready of the line.
        const char* p = device.next();
        for (; p != device.limit() && length < nimbLineLength && *p != '\n' && *p != '\r'; ++p)
            buffer73[length++] = static_cast<unsigned char>(*p);
        device.advanceTo(p);
        c = s.getChar();
    }
    if (c == '\r') {
        const int after = s.getChar();
        if (after != '\n') s.ungetChar(after);
    }
    buffer73[length] = 0;
    return length;
}

bool nimbRead(NimbRecord& rec, Ov::RnStream& s) {
    nimbLineNumber = 0;
    rec = NimbRecord();
    if (withinMemory(
            [&] { return readHeader(rec, s) && readTextLines(rec, s) && checkHeader(rec) && readValues(rec, s); }))
        return true;
    rec = NimbRecord();
    return false;
}

}  // namespace OvPhotometrics
