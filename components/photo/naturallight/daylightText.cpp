#include "components/photo/naturallight/daylightForms.h"

#include <cmath>
#include <cwchar>
#include <string>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/angles.h"
#include "components/photo/lid/reportMessage.h"
#include "components/photo/naturallight/formParts.h"

namespace OvPhotometrics {

namespace {

using Settings = Ov::NaturalLightSettings;
using Ov::RnStream;
namespace m = messages;

/// Writes line after line; without a stream it only looks for what could not be read back.
class TextWriter {
public:
    explicit TextWriter(RnStream* out) : _out(out) {}

    template <class... Values>
    void line(const wchar_t* format, Values... values) {
        if (_out) _out->formattedWrite(format, values...);
    }
    void number(const wchar_t* format, float value) {
        check(format, value);
        line(format, static_cast<double>(value));
    }
    void degrees(const wchar_t* format, float radians) { number(format, static_cast<float>(inDegrees(radians))); }
    void word(const wchar_t* format, bool value, const wchar_t* whenFalse, const wchar_t* whenTrue) {
        line(format, value ? whenTrue : whenFalse);
    }
    void color(const wchar_t* format, const std::array<float, 3>& c) {
        for (const float value : c) check(format, value);
        line(format, static_cast<double>(c[0]), static_cast<double>(c[1]), static_cast<double>(c[2]));
    }

    /// The name of the first line with a number that is not finite, or empty.
    const std::wstring& notFinite() const { return _notFinite; }

private:
    void check(std::wstring_view format, float value) {
        if (std::isfinite(value) || !_notFinite.empty()) return;
        if (format.starts_with(L'\n')) format.remove_prefix(1);
        _notFinite = format.substr(0, format.find(L':'));
    }

    RnStream* _out;
    std::wstring _notFinite;
};

void writeOverrides(TextWriter& text, const Settings& s) {
    text.word(L"\nOverwrite Solar Position: %s\n", s.overrideSolarPosition, L"No", L"Yes");
    if (s.overrideSolarPosition) {
        text.number(L"Solar Altitude: %.16g\n", s.solarAltitude);
        text.number(L"Solar Azimuth: %.16g\n", s.solarAzimuth);
    }
    text.word(L"Overwrite Solar Illuminance: %s\n", s.overrideSolarIlluminance, L"No", L"Yes");
    if (s.overrideSolarIlluminance)
        text.number(L"Direct Normal Solar Illuminance: %.16g\n", s.directNormalIlluminance);
}

/// Reads line after line. A line that fails is reported once and ends the reading: every operation answers false
/// where its line cannot be read.
class TextReader {
public:
    explicit TextReader(RnStream& in) : _in(in) {}

    /// Reads `count` fields; `message` when there are fewer.
    template <class... Targets>
    bool fields(int count, Ov::Message<> message, const wchar_t* format, Targets*... targets) {
        return _in.formattedRead(format, targets...) == count || fail(message);
    }

    bool number(Ov::Message<> message, const wchar_t* format, float& value) {
        double read = 0;
        if (!fields(1, message, format, &read)) return false;
        value = static_cast<float>(read);
        return isWritable(value, message);
    }

    bool degrees(Ov::Message<> message, const wchar_t* format, float& radians) {
        double read = 0;
        if (!fields(1, message, format, &read)) return false;
        radians = toRadians(read);
        return isWritable(static_cast<float>(inDegrees(radians)), message);
    }

    bool color(Ov::Message<> message, const wchar_t* format, std::array<float, 3>& c) {
        return fields(3, message, format, &c[0], &c[1], &c[2]);
    }

    /// A word that starts with one of two others; `wordMessage` when it starts with neither.
    bool word(Ov::Message<> message, Ov::Message<> wordMessage, const wchar_t* format, const wchar_t* whenFalse,
              const wchar_t* whenTrue, bool& value) {
        wchar_t word[4] = {};
        if (!fields(1, message, format, word)) return false;
        value = startsWith(word, whenTrue);
        return value || startsWith(word, whenFalse) || fail(wordMessage);
    }

    /// "Yes", or any other word for no.
    bool yes(Ov::Message<> message, const wchar_t* format, bool& value) {
        wchar_t word[4] = {};
        if (!fields(1, message, format, word)) return false;
        value = startsWith(word, L"Yes");
        return true;
    }

    bool flags(Ov::Message<> message, const wchar_t* format, void (*set)(Settings&, unsigned), Settings& s) {
        unsigned short word = 0;
        if (!fields(1, message, format, &word)) return false;
        set(s, word);
        return true;
    }

private:
    static bool startsWith(const wchar_t* word, const wchar_t* start) {
        return std::wcsncmp(word, start, std::wcslen(start)) == 0;
    }
    /// A number that is too large for a float counts as missing, since it could not be written again.
    bool isWritable(float number, Ov::Message<> message) { return std::isfinite(number) || fail(message); }
    bool fail(Ov::Message<> message) {
        reportFormError(message, _in.computeLineNb());
        return false;
    }

    RnStream& _in;
};

/// What every release has.
bool readCommon(TextReader& text, Settings& s) {
    return text.word(m::daylightOnOff, m::daylightOnOffWord, L" Natural light is: %3s\n", L"Off", L"On",
                     s.enabled) &&
           text.word(m::daylightInOut, m::daylightInOutWord, L"In/Out: %3s\n", L"In", L"Out", s.outside) &&
           text.degrees(m::daylightNorth, L"North: %lg\n", s.north) &&
           text.degrees(m::daylightLatitude, L"Latitude: %lg\n", s.latitude) &&
           text.degrees(m::daylightLongitude, L"Longitude: %lg\n", s.longitude) &&
           text.fields(1, m::daylightDay, L"Day: %hd\n", &s.day) &&
           text.word(m::daylightSaving, m::daylightSavingWord, L"Daylight Savings Time: %3s\n", L"No", L"Yes",
                     s.daylightSaving) &&
           text.number(m::daylightLocalTime, L"Local Time: %lg\n", s.localTime) &&
           text.number(m::daylightTimeZone, L"Time Zone: %lg\n", s.timeZone) &&
           text.number(m::daylightSkyCover, L"Sky Cover: %lg\n", s.skyCover) &&
           text.color(m::daylightSunColor, L"Sun Color: %g %g %g\n", s.sunColor) &&
           text.color(m::daylightSkyColor, L"Sky Color: %g %g %g\n", s.skyColor);
}

bool readPosition(TextReader& text, Settings& s) {
    if (!text.word(m::daylightOverwritePosition, m::daylightOverwritePositionWord,
                   L"Overwrite Solar Position: %3s\n", L"No", L"Yes", s.overrideSolarPosition))
        return false;
    return !s.overrideSolarPosition ||
           (text.number(m::daylightSolarAltitude, L"Solar Altitude: %lg\n", s.solarAltitude) &&
            text.number(m::daylightSolarAzimuth, L"Solar Azimuth: %lg\n", s.solarAzimuth));
}

bool readIlluminance(TextReader& text, Settings& s) {
    if (!text.word(m::daylightOverwriteIlluminance, m::daylightOverwriteIlluminanceWord,
                   L"Overwrite Solar Illuminance: %3s\n", L"No", L"Yes", s.overrideSolarIlluminance))
        return false;
    return !s.overrideSolarIlluminance ||
           text.number(m::daylightDirectNormalIlluminance, L"Direct Normal Solar Illuminance: %lg\n",
                       s.directNormalIlluminance);
}

bool readFlags(TextReader& text, Settings& s) {
    return text.flags(m::daylightSunFlags, L"Sun Flags: 0x%hx\n", setSunFlags, s) &&
           text.flags(m::daylightSkyFlags, L"Sky Flags: 0x%hx\n", setSkyFlags, s);
}

void writeLines(TextWriter& text, const Settings& s) {
    text.line(L"Marovendel Natural Light Version %d, Release %d\n\n", formVersion, formRelease);
    text.word(L"Natural light is: %s\n", s.enabled, L"Off", L"On");
    text.word(L"In/Out: %s\n", s.outside, L"In", L"Out");
    text.degrees(L"North: %.16g\n", s.north);
    text.degrees(L"Latitude: %.16g\n", s.latitude);
    text.degrees(L"Longitude: %.16g\n", s.longitude);
    text.line(L"Day: %d\n", static_cast<int>(s.day));
    text.word(L"Daylight Savings Time: %s\n", s.daylightSaving, L"No", L"Yes");
    text.number(L"Local Time: %.16g\n", s.localTime);
    text.number(L"Time Zone: %.16g\n", s.timeZone);
    text.number(L"Sky Cover: %.16g\n", s.skyCover);
    text.color(L"Sun Color: %.16g %.16g %.16g\n", s.sunColor);
    text.color(L"\nSky Color: %.16g %.16g %.16g\n", s.skyColor);
    writeOverrides(text, s);
    text.line(L"Sun Flags: 0x%x\n", static_cast<int>(sunFlagWord(s)));
    text.line(L"Sky Flags: 0x%x\n", static_cast<int>(skyFlagWord(s)));
    text.number(L"Sky Shadows Accuracy: %.3g\n", s.skyShadowAccuracy);
    text.line(L"\n");
}

}  // namespace

bool writeDaylightText(RnStream& out, const Settings& s) {
    TextWriter trial(nullptr);
    writeLines(trial, s);
    if (!trial.notFinite().empty()) {
        reportMessage(m::daylightNotFinite, trial.notFinite());
        return false;
    }
    TextWriter text(&out);
    writeLines(text, s);
    return true;
}

std::optional<Settings> readDaylightText(RnStream& in) {
    TextReader text(in);
    Settings s;
    int version = 0;
    int release = 0;
    const bool isRead =
        text.fields(2, m::daylightHeader, L" Marovendel Natural Light Version %d, Release %d", &version,
                    &release) &&
        readCommon(text, s) && (release < 1 || (readPosition(text, s) && readIlluminance(text, s))) &&
        (release != 2 || text.yes(m::daylightSkyCastsShadows, L"Sky Casts Shadows: %3s\n", s.skyCastsShadows)) &&
        (release < 3 || readFlags(text, s)) &&
        (release < 2 ||
         text.number(m::daylightSkyShadowsAccuracy, L"Sky Shadows Accuracy: %lg\n", s.skyShadowAccuracy));
    return isRead ? std::optional(s) : std::nullopt;
}

}  // namespace OvPhotometrics
