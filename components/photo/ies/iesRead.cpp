#include <algorithm>
#include <cmath>
#include <new>
#include <string_view>

#include "components/messageFile/messageIds.h"
#include "components/photo/ies/ies.h"
#include "components/photo/lid/withinMemory.h"
#include "components/support/file.h"
#include "host/componentManager/processController.h"

namespace OvPhotometrics {

namespace {

constexpr std::wstring_view tiltKey = L"TILT=";

template <class... Types>
bool refuse(Ov::Message<Types...> message, Ov::ArgumentFor<Types>... arguments) {
    reportParseMessage(message, arguments...);
    return false;
}

/// Header lines up to the TILT= line, whose value is `tiltValue`.
bool readHeader(IesFileRecord& rec, Ov::RnStream& in, std::wstring& tiltValue) {
    std::wstring line;
    while (readTextLine(in, L"%80[^\r\n]", line)) {
        if (line.starts_with(tiltKey)) {
            tiltValue = line.substr(tiltKey.size());
            return true;
        }
        rec.lines.push_back(line);
    }
    return refuse(messages::tiltLineMissing);
}

/// Whether `text` is `word` in either letter case, followed by nothing but white space.
bool isWord(std::wstring_view text, std::wstring_view word) {
    const auto upper = [](wchar_t c) { return c >= L'a' && c <= L'z' ? static_cast<wchar_t>(c - 32) : c; };
    if (text.size() < word.size()) return false;
    return std::equal(word.begin(), word.end(), text.begin(),
                      [&](wchar_t a, wchar_t b) { return a == upper(b); }) &&
           text.find_first_not_of(L" \t\n\v\f\r", word.size()) == std::wstring_view::npos;
}

bool readTiltFile(IesFileRecord& rec, const wchar_t* basePath) {
    const std::wstring path = iesFindTiltFile(rec.tiltFile, basePath);
    if (path.empty()) {
        reportMessage(messages::tiltFileNotFound, rec.tiltFile);
        return false;
    }
    try {
        if (const auto file = Ov::openInputFile(path.c_str())) {
            Ov::RnStream stream(file.get(), Ov::RnStream::Form::text);
            return iesReadTilt(rec.tilt, stream);
        }
    } catch (const Ov::RnStreamEx::ExReadError&) {  // it is not the device of the stream that fails
    }
    reportMessage(messages::tiltFileNotOpened, path);
    return false;
}

bool readTiltValue(IesFileRecord& rec, Ov::RnStream& in, const std::wstring& value, const wchar_t* basePath) {
    if (isWord(value, L"NONE")) return true;
    if (isWord(value, L"INCLUDE")) {
        rec.tiltKind = IesTiltKind::include;
        return iesReadTilt(rec.tilt, in);
    }
    rec.tiltKind = IesTiltKind::file;
    rec.tiltFile = value;
    return readTiltFile(rec, basePath);
}

/// The angles of a tilt block. A number that fails is compared with nothing.
bool readTiltAngles(NumberText& in, int pairs, std::vector<float>& angles) {
    float angle = 0;
    bool comparable = true;
    for (int i = 0; i < pairs && !in.ended(); ++i) {
        const bool previousComparable = comparable;
        comparable = in.readFloat(angle);
        if (comparable && i == 0 && angle != 0) return refuse(messages::tiltFirstAngle, angle);
        if (comparable && previousComparable && i > 0 && !(angle > angles.back()))
            return refuse(messages::tiltAngleOrder, angles.back(), angle);
        angles.push_back(angle);
    }
    const auto about = [&](float limit) { return std::fabs(double{angle} - limit) <= 0.1; };
    if (comparable && !about(90) && !about(180)) return refuse(messages::tiltLastAngle, angle);
    return !in.failed() || refuse(messages::tiltAngles, pairs);
}

bool readTiltBlock(IesTilt& tilt, NumberText& in) {
    if (!in.readInteger(tilt.geometry, messages::tiltGeometry, 1, 3)) return false;
    std::int32_t pairs = 0;
    if (!in.readInteger(pairs, messages::tiltPairCount, 2)) return false;
    return readTiltAngles(in, pairs, tilt.tiltAngles) &&
           (in.readFloats(static_cast<std::size_t>(pairs), tilt.tiltFactors) ||
            refuse(messages::tiltFactors, pairs));
}

bool readNumbers(IesFileRecord& rec, NumberText& in) {
    if (!in.readInteger(rec.lampCount, messages::lampCount, 1)) return false;
    in.readFloat(rec.lumensPerLamp);
    in.readFloat(rec.candelaMultiplier);
    if (!candelaGridReadCounts(rec.grid, in)) return false;
    std::int32_t type = 0;
    if (!in.readInteger(type, messages::photometricType, 1, 3)) return false;
    rec.photometricType = static_cast<IesPhotometricType>(type);
    if (!in.readInteger(rec.unitsType, messages::unitsType, 1, 2)) return false;
    for (float* dimension : {&rec.width, &rec.length, &rec.height}) in.readFloat(*dimension);
    if (in.failed()) return refuse(messages::dimensions);
    for (float* factor : {&rec.ballastFactor, &rec.ballastLampFactor, &rec.inputWatts}) in.readFloat(*factor);
    if (in.failed()) return refuse(messages::factors);
    return candelaGridRead(rec.grid, in);
}

bool readFile(IesFileRecord& rec, Ov::RnStream& in, const wchar_t* basePath) {
    std::wstring tiltValue;
    if (!readHeader(rec, in, tiltValue) || !readTiltValue(rec, in, tiltValue, basePath)) return false;
    NumberText numbers(in, NumberText::AtEnd::notConverted);
    return readNumbers(rec, numbers);
}

}  // namespace

std::wstring iesFindTiltFile(const std::wstring& name, const wchar_t* basePath) {
    std::wstring path;
    const auto controller = Ov::rnCast<Ov::RnProcessController>(Ov::RnGetThreadProcessController());
    controller->findFile(path, name.c_str(), basePath, L"WebPathList");
    return path;
}

bool iesReadTilt(IesTilt& tilt, Ov::RnStream& in) {
    try {
        tilt = IesTilt();
        NumberText numbers(in, NumberText::AtEnd::notConverted);
        return readTiltBlock(tilt, numbers);
    } catch (const std::bad_alloc&) {
        return refuse(messages::outOfMemory);
    }
}

bool iesReadRecord(IesFileRecord& rec, Ov::RnStream& in, const wchar_t* basePath) {
    const auto read = [&] {
        rec = IesFileRecord();  // whose empty lines take memory
        return readFile(rec, in, basePath);
    };
    if (withinMemory(read)) return true;
    rec = IesFileRecord();
    return false;
}

bool iesCanRead(Ov::RnBufferedIO& io) {
    if (matchesAt(io, L"IESNA91")) return true;
    const long start = io.seek(0, 1);
    Ov::RnCharInput in(io);
    bool found = false;
    for (int c = 0; c >= 0 && !found;) {
        found = matchesAt(io, tiltKey.data());
        in.takeWhile([](int character) { return character != '\n'; });
        c = in.getChar();
    }
    io.seek(start, 0);
    return found;
}

}  // namespace OvPhotometrics
