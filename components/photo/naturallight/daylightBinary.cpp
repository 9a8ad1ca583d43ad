#include <string>

#include "components/messageFile/messageIds.h"
#include "components/photo/naturallight/daylightForms.h"
#include "components/photo/naturallight/formParts.h"
#include "components/support/charInput.h"
#include "components/support/devices.h"

namespace OvPhotometrics {

namespace {

using Settings = Ov::NaturalLightSettings;
using Ov::RnStream;

/// The numbers of the file behind version and release.
struct BinaryForm {
    unsigned short enabled, outside;
    int padding1 = 0;
    double north, latitude, longitude;
    int day, daylightSaving;
    float localTime;
    int padding2 = 0;
    double timeZone;
    float skyCover;
    std::array<float, 3> sunColor, skyColor;
    int padding3 = 0;

    unsigned short overrideSolarPosition, overrideSolarIlluminance;
    float solarAltitude, solarAzimuth, directNormalIlluminance;
    unsigned short skyCastsShadows;
    float skyShadowAccuracy;
    unsigned short sunFlags, skyFlags;

    explicit BinaryForm(const Settings& s);
    Settings settings(int release) const;

    /// Calls `visit` for every number that a release has, in the file's order.
    template <class Visit>
    void forEach(int release, Visit visit) {
        const auto all = [&](auto&... numbers) { (visit(numbers), ...); };
        all(enabled, outside, padding1, north, latitude, longitude, day, daylightSaving, localTime, padding2,
            timeZone, skyCover, sunColor[0], sunColor[1], sunColor[2], skyColor[0], skyColor[1], skyColor[2],
            padding3);
        if (release >= 1)
            all(overrideSolarPosition, overrideSolarIlluminance, solarAltitude, solarAzimuth,
                directNormalIlluminance);
        if (release == 2) all(skyCastsShadows);
        if (release >= 2) all(skyShadowAccuracy);
        if (release >= 3) all(sunFlags, skyFlags);
    }

    int size(int release) {
        int bytes = 0;
        forEach(release, [&](auto& number) { bytes += static_cast<int>(sizeof number); });
        return bytes;
    }
};

BinaryForm::BinaryForm(const Settings& s)
    : enabled(s.enabled),
      outside(s.outside),
      north(s.north),
      latitude(s.latitude),
      longitude(s.longitude),
      day(s.day),
      daylightSaving(s.daylightSaving),
      localTime(s.localTime),
      timeZone(s.timeZone),
      skyCover(s.skyCover),
      sunColor(s.sunColor),
      skyColor(s.skyColor),
      overrideSolarPosition(s.overrideSolarPosition),
      overrideSolarIlluminance(s.overrideSolarIlluminance),
      solarAltitude(s.solarAltitude),
      solarAzimuth(s.solarAzimuth),
      directNormalIlluminance(s.directNormalIlluminance),
      skyCastsShadows(s.skyCastsShadows),
      skyShadowAccuracy(s.skyShadowAccuracy),
      sunFlags(sunFlagWord(s)),
      skyFlags(skyFlagWord(s)) {}

Settings BinaryForm::settings(int release) const {
    Settings s;
    s.enabled = enabled != 0;
    s.outside = outside != 0;
    s.north = static_cast<float>(north);
    s.latitude = static_cast<float>(latitude);
    s.longitude = static_cast<float>(longitude);
    s.day = static_cast<std::int16_t>(day);
    s.daylightSaving = daylightSaving != 0;
    s.localTime = localTime;
    s.timeZone = static_cast<float>(timeZone);
    s.skyCover = skyCover;
    s.sunColor = sunColor;
    s.skyColor = skyColor;
    s.overrideSolarPosition = overrideSolarPosition != 0;
    s.overrideSolarIlluminance = overrideSolarIlluminance != 0;
    s.solarAltitude = solarAltitude;
    s.solarAzimuth = solarAzimuth;
    s.directNormalIlluminance = directNormalIlluminance;
    s.skyShadowAccuracy = skyShadowAccuracy;
    setSunFlags(s, sunFlags);
    setSkyFlags(s, skyFlags);
    // A field of its own in release 2 alone; from release 3 on it is one of the flags.
    if (release == 2) s.skyCastsShadows = skyCastsShadows != 0;
    return s;
}

/// The stream's next bytes, fewer where it ends. Taken from the device: the typed operations do not tell the end
/// of the input from other failures.
std::string nextBytes(RnStream& in, int count) {
    std::string bytes(static_cast<std::size_t>(count), '\0');
    bytes.resize(static_cast<std::size_t>(Ov::rnReadBytes(in.device(), bytes.data(), count)));
    return bytes;
}

/// Reads from the next `count` bytes as from a stream of their own; false, reported, when there are fewer.
template <class Read>
bool readBlock(RnStream& in, int count, Read read) {
    const std::string bytes = nextBytes(in, count);
    if (bytes.size() < static_cast<std::size_t>(count)) {
        reportFormError(messages::daylightHeader, 0);
        return false;
    }
    RnStream block(Ov::rnCreate<Ov::RnMemoryBuffer>(bytes).get(), RnStream::Form::binary);
    read(block);
    return true;
}

}  // namespace

void writeDaylightBinary(RnStream& out, const Settings& settings) {
    out.write(static_cast<unsigned short>(formVersion), 1);
    out.write(static_cast<short>(formRelease), 1);
    BinaryForm(settings).forEach(formRelease, [&](auto& number) { out.write(number, 1); });
}

std::optional<Settings> readDaylightBinary(RnStream& in) {
    unsigned short version = 0;
    short release = 0;
    if (!readBlock(in, 4, [&](RnStream& block) { block >> version >> release; })) return {};
    BinaryForm form{Settings()};
    if (version != formVersion) return Settings();
    const auto readForm = [&](RnStream& block) { form.forEach(release, [&](auto& number) { block >> number; }); };
    if (!readBlock(in, form.size(release), readForm)) return {};
    return form.settings(release);
}

}  // namespace OvPhotometrics
