#include "tools/ovphoto/naturalLight.h"

#include <algorithm>

#include "components/support/charInput.h"
#include "components/support/devices.h"
#include "host/componentManager/persistant.h"
#include "ovphoto/classIds.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/language.h"
#include "tools/ovphoto/messageCollector.h"
#include "tools/ovphoto/placeAndTime.h"

namespace OvTool {

using namespace Ov;

namespace {

/// The first bytes of the input: in the binary form, version and release.
std::string peek(RnBufferedIO& io) {
    char bytes[4];
    const int count = rnReadBytes(io, bytes, sizeof bytes);
    io.seek(0, 0);
    return std::string(bytes, static_cast<std::size_t>(count));
}

/// The saved forms, told by content: version and release are small numbers of two bytes, so that NUL is among
/// them.
RnStream::Form formOf(const std::string& start) {
    return start.find('\0') == std::string::npos ? RnStream::Form::text : RnStream::Form::binary;
}

/// The binary form of another version is taken, by the rules of the form, for the defaults.
bool isForeign(const std::string& start) {
    return formOf(start) == RnStream::Form::binary && start.substr(0, 2) != std::string("\1\0", 2);
}

bool loadFrom(RnNaturalLight& naturalLight, RnBufferedIO& io, std::vector<std::string>& reasons) {
    const std::string start = peek(io);
    RnStream stream(&io, formOf(start));
    if (!rnCast<RnPersistant>(&naturalLight)->load(stream, 0, nullptr, nullptr)) return false;
    if (isForeign(start))
        reasons.push_back(inLanguage("of an unknown version; the defaults are taken",
                                     "von unbekannter Version; es gelten die Vorgaben"));
    return true;
}

std::string rangeNote(const char* what, float value, const char* unit, float taken) {
    return std::string(what) + " " + shortNumber(value) + unit +
           inLanguage(" is out of range; computed with ", " liegt außerhalb des Bereichs; gerechnet wird mit ") +
           shortNumber(taken) + unit;
}

}  // namespace

RnRef<RnNaturalLight> createDaylight(const HostSession& session) {
    const auto object = session.manager().createObject(OvPhotometrics::classIds::naturalLight);
    if (!object) throw ExModule("the module builds no natural light");
    return rnCast<RnNaturalLight>(object.get());
}

bool loadDaylight(RnNaturalLight& naturalLight, const std::string& file, std::vector<std::string>& reasons) {
    std::string error;
    try {
        const MessageCollector collector(reasons);
        const RnRef<RnBufferedIO> io = openFile(file, error);
        if (io && loadFrom(naturalLight, *io, reasons)) return true;
    } catch (...) {
        error = inLanguage("cannot be read: ", "nicht lesbar: ") + currentExceptionText();
    }
    if (error.empty() && reasons.empty()) error = inLanguage("refused by the module", "vom Modul abgelehnt");
    if (!error.empty()) reasons.push_back(error);
    return false;
}

std::string savedDaylight(RnNaturalLight& naturalLight, RnStream::Form form) {
    const auto buffer = rnCreate<RnMemoryBuffer>();
    RnStream stream(buffer.get(), form);
    rnCast<RnPersistant>(&naturalLight)->save(stream);
    return buffer->bytes();
}

std::vector<std::string> outOfRange(const RnNaturalLight& naturalLight) {
    NaturalLightSettings settings;
    naturalLight.getSettings(settings);
    std::vector<std::string> notes;
    const auto check = [&](const char* what, float value, const char* unit, float low, float high, float below,
                           float above) {
        if (value < low || value > high)
            notes.push_back(rangeNote(what, value, unit, value < low ? below : above));
    };
    const char* degrees = inLanguage(" deg", " Grad");
    check(inLanguage("day", "Tag"), settings.day, "", 1, 365, 1, 365);
    check(inLanguage("latitude", "Breite"), naturalLight.getLatitude(), degrees, -90, 90, -90, 90);
    check(inLanguage("longitude", "Länge"), naturalLight.getLongitude(), degrees, -180, 180, -180, -180);
    check(inLanguage("time zone", "Zeitzone"), naturalLight.getTimeZone(), degrees, -180, 180, -180, -180);
    check(inLanguage("sky cover", "Bedeckung"), settings.skyCover, "", 0, 1, 0, 1);
    return notes;
}

std::string siteText(const RnNaturalLight& naturalLight, const OvPhotometrics::NumberedFunctions& functions) {
    return latitudeText(naturalLight.getLatitude()) + ", " + longitudeText(naturalLight.getLongitude()) + ", " +
           utcText(functions, naturalLight.getTimeZoneHours());
}

const char* skyText(float cover) {
    return cover < 0.35F    ? inLanguage("clear", "klar")
           : cover <= 0.75F ? inLanguage("partly cloudy", "teils bewölkt")
                            : inLanguage("overcast", "bedeckt");
}

std::string dateText(const RnNaturalLight& naturalLight, const OvPhotometrics::NumberedFunctions& functions) {
    const std::string day =
        inLanguage("day ", "Tag ") + std::to_string(static_cast<std::int16_t>(naturalLight.getDayOfYear()));
    if (naturalLight.getMonth() == 0) return day;
    const std::string month = toUtf8(functions.getMonthName(naturalLight.getMonth()));
    return std::to_string(naturalLight.getDayOfMonth()) + inLanguage(" ", ". ") + month + ", " + day;
}

}  // namespace OvTool
