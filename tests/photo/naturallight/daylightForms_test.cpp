#include <cstring>
#include <functional>
#include <random>

#include "components/photo/naturallight/daylightData.h"
#include "tests/photo/photoFixture.h"

namespace OvPhotometrics {
namespace {

using Settings = Ov::NaturalLightSettings;

class LightForms : public Photo {
protected:
    bool load(const std::string& bytes, Form form) { return Photo::load(*light, bytes, form); }
    std::string save(Form form) { return saved(*light, form); }
    Settings settings() const {
        Settings all;
        light->getSettings(all);
        return all;
    }
    /// Loads what must be refused and leave the object as it was; the report.
    std::string refusal(const std::string& bytes, Form form) {
        light->setLatitude(12);
        const Settings before = settings();
        EXPECT_FALSE(load(bytes, form));
        EXPECT_EQ(settings(), before);
        return log.take();
    }

    RnRef<DaylightData> light = Ov::rnCreate<DaylightData>();
};

/// Settings with every flag, word and override at random.
Settings randomSettings(std::mt19937& random) {
    const auto flag = [&] { return random() % 2 == 0; };
    const auto value = [&] { return std::uniform_real_distribution<float>(-3, 3)(random); };
    Settings s;
    for (bool* b : {&s.enabled, &s.outside, &s.daylightSaving, &s.sunCastsShadows, &s.sunFlag2, &s.sunFlag3,
                    &s.skyCastsShadows, &s.skyFlag2, &s.skyFlag3})
        *b = flag();
    for (float* f : {&s.north, &s.latitude, &s.longitude, &s.localTime, &s.timeZone, &s.skyCover}) *f = value();
    s.day = static_cast<std::int16_t>(random());
    s.skyShadowAccuracy = static_cast<float>(static_cast<int>(random() % 999)) / 1000;
    s.sunColor = {value(), value(), value()};
    s.skyColor = {value(), value(), value()};
    s.overrideSolarPosition = flag();
    if (s.overrideSolarPosition) s.solarAltitude = value(), s.solarAzimuth = value();
    s.overrideSolarIlluminance = flag();
    if (s.overrideSolarIlluminance) s.directNormalIlluminance = value() * 50000;
    return s;
}

TEST_F(LightForms, ReadBackTheSame) {
    std::mt19937 random(1);
    for (int i = 0; i < 200; ++i) {
        const Settings written = randomSettings(random);
        for (const Form form : {Form::text, Form::binary}) {
            light->setSettings(written);
            const std::string bytes = save(form);
            light->reset();
            ASSERT_TRUE(load(bytes, form));
            Settings read = settings();
            if (form == Form::text) {  // degrees, which cost a rounding
                EXPECT_FLOAT_EQ(read.north, written.north);
                EXPECT_FLOAT_EQ(read.latitude, written.latitude);
                EXPECT_FLOAT_EQ(read.longitude, written.longitude);
                read.north = written.north, read.latitude = written.latitude, read.longitude = written.longitude;
            }
            EXPECT_EQ(read, written) << bytes;
        }
    }
    EXPECT_EQ(log.take(), "");
}

TEST_F(LightForms, WhatIsNotFiniteIsSavedWholeOrRefused) {
    const std::pair<const char*, std::function<void(Settings&, float)>> cases[] = {
        {"North", [](Settings& s, float bad) { s.north = bad; }},
        {"Latitude", [](Settings& s, float bad) { s.latitude = bad; }},
        {"Longitude", [](Settings& s, float bad) { s.longitude = bad; }},
        {"Local Time", [](Settings& s, float bad) { s.localTime = bad; }},
        {"Time Zone", [](Settings& s, float bad) { s.timeZone = bad; }},
        {"Sky Cover", [](Settings& s, float bad) { s.skyCover = bad; }},
        {"Sun Color", [](Settings& s, float bad) { s.sunColor[2] = bad; }},
        {"Sky Color", [](Settings& s, float bad) { s.skyColor[0] = bad; }},
        {"Solar Altitude", [](Settings& s, float bad) { s.solarAltitude = bad; }},
        {"Solar Azimuth", [](Settings& s, float bad) { s.solarAzimuth = bad; }},
        {"Direct Normal Solar Illuminance", [](Settings& s, float bad) { s.directNormalIlluminance = bad; }},
        {"Sky Shadows Accuracy", [](Settings& s, float bad) { s.skyShadowAccuracy = bad; }}};
    constexpr float infinite = std::numeric_limits<float>::infinity();
    const auto refused = [&](const Settings& s, const std::string& line) {
        SCOPED_TRACE(line);
        light->setSettings(s);
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), Form::text);
        EXPECT_THROW(Ov::rnCast<Ov::RnPersistant>(light.get())->save(stream), Ov::RnStreamEx::ExWriteError);
        EXPECT_EQ(log.take(), "13081 " + line);
        EXPECT_EQ(io->bytes(), "");
    };
    for (const auto& [line, set] : cases)
        for (const float bad : {infinite, -infinite, std::nanf("")}) {
            Settings s;
            s.overrideSolarPosition = s.overrideSolarIlluminance = true;
            set(s, bad);
            refused(s, line);
            const std::string bytes = save(Form::binary);
            light->reset();
            EXPECT_TRUE(load(bytes, Form::binary));
            EXPECT_EQ(save(Form::binary), bytes);
        }
    refused({.latitude = 3e38f}, "Latitude");                                              // too many degrees
    light->setSettings({.solarAltitude = infinite, .directNormalIlluminance = infinite});  // not overridden
    const std::string text = save(Form::text);
    EXPECT_TRUE(load(text, Form::text));
    std::string color = text;
    color.replace(color.find("Sun Color: 1 "), 13, "Sun Color: 1e39 ");
    EXPECT_EQ(refusal(color, Form::text).substr(0, 11), "12896 12912");
}

/// The lines of a text form that has all sections of release 3, and what is reported without them.
struct Line {
    std::string key, value;
    unsigned missing;
    unsigned wrongWord = 0;  // for a word that is none of two
    bool isAfterBlank = false;
};

const Line lines[] = {
    {"Marovendel Natural Light Version ", "1, Release 3", 12898},
    {"Natural light is: ", "On", 12899, 12900, true},
    {"In/Out: ", "In", 12901, 12902},
    {"North: ", "0", 12903},
    {"Latitude: ", "41", 12904},
    {"Longitude: ", "74", 12905},
    {"Day: ", "172", 12906},
    {"Daylight Savings Time: ", "Yes", 12907, 12908},
    {"Local Time: ", "10", 12909},
    {"Time Zone: ", "1.308996915817261", 12910},
    {"Sky Cover: ", "0", 12911},
    {"Sun Color: ", "1 0.949999988079071 0.8999999761581421", 12912},
    {"Sky Color: ", "0.949999988079071 0.949999988079071 1", 12913, 0, true},
    {"Overwrite Solar Position: ", "Yes", 12914, 12915, true},
    {"Solar Altitude: ", "0.5", 12916},
    {"Solar Azimuth: ", "-0.25", 12917},
    {"Overwrite Solar Illuminance: ", "Yes", 12918, 12919},
    {"Direct Normal Solar Illuminance: ", "50000", 12920},
    {"Sun Flags: ", "0x100", 12922},
    {"Sky Flags: ", "0x200", 12923},
    {"Sky Shadows Accuracy: ", "0.5", 12924},
};

struct Text {
    std::string text;
    int line = 1;  // of what was changed

    /// All lines, but one of them changed.
    static Text with(const Line* changed, const std::string& instead) {
        Text all;
        for (const Line& l : lines) {
            if (l.isAfterBlank) all.text += "\n";
            if (&l == changed) all.line = 1 + static_cast<int>(std::ranges::count(all.text, '\n'));
            all.text += &l == changed ? instead : l.key + l.value + "\n";
        }
        all.text += "\n";
        return all;
    }
    static std::string whole() { return with(nullptr, "").text; }
};

TEST_F(LightForms, TextIsWrittenToTheByte) {
    Settings s;
    s.overrideSolarPosition = s.overrideSolarIlluminance = true;
    s.solarAltitude = 0.5f;
    s.solarAzimuth = -0.25f;
    s.directNormalIlluminance = 50000;
    light->setSettings(s);
    EXPECT_EQ(save(Form::text), Text::whole());
    ASSERT_TRUE(load(Text::whole(), Form::text));
    EXPECT_EQ(settings(), s);
}

TEST_F(LightForms, EachLineHasItsOwnMessage) {
    for (const Line& line : lines) {
        SCOPED_TRACE(line.key);
        const auto refused = [&](const std::string& text, unsigned id, int at) {
            EXPECT_EQ(refusal(text, Form::text), "12896 " + std::to_string(id) + " " + std::to_string(at));
        };
        const Text missing = Text::with(&line, ""), wrong = Text::with(&line, line.key + "Wrong\n");
        // Without it reading stops where the next line starts, behind blank ones.
        const bool isLast = &line == std::end(lines) - 1;
        refused(missing.text, line.missing, missing.line + (isLast || (&line)[1].isAfterBlank));
        refused(wrong.text, line.wrongWord ? line.wrongWord : line.missing, wrong.line);
        refused(wrong.text.substr(0, wrong.text.find("Wrong")), line.missing, wrong.line);
    }
}

TEST_F(LightForms, TextIsReadInThreeCharacterWordsAndBits) {
    const std::string text = Text::whole();
    const auto replaced = [&](const char* from, const char* to) {
        std::string other = text;
        return other.replace(other.find(from), std::strlen(from), to);
    };
    EXPECT_TRUE(load(replaced("is: On\n", "is: One\n"), Form::text));
    EXPECT_TRUE(load(replaced("0x100\nSky Flags: 0x200", "0x600\nSky Flags: 0xFFFF"), Form::text));
    EXPECT_FALSE(light->getSunCastsShadows() || light->getSunFlag3() || light->getSkyCastsShadows());
    EXPECT_EQ(refusal(replaced("is: On\n", "is: Onward\n"), Form::text), "12896 12901 3");
    EXPECT_EQ(refusal(replaced("is: On\n", "is: on\n"), Form::text).substr(0, 11), "12896 12900");
    EXPECT_EQ(refusal(replaced("172", "40000"), Form::text).substr(0, 11), "12896 12906");
    EXPECT_TRUE(load(replaced("is: On\n", "is:Off In/Out: Out\n#"), Form::text) == false);
    EXPECT_TRUE(load(replaced("\nIn/Out", " In/Out"), Form::text));
}

TEST_F(LightForms, BinaryIsLittleEndianAtFixedPlaces) {
    Settings s;
    s.day = -2;
    s.skyCover = 1;
    s.timeZone = 0.5f;
    s.directNormalIlluminance = -2;
    s.sunFlag2 = false;
    light->setSettings(s);
    const std::string bytes = save(Form::binary);
    ASSERT_EQ(bytes.size(), 116U);
    const struct {
        std::size_t offset;
        std::string_view bytes;
    } cases[] = {
        {0, {"\1\0\3\0\1\0\0\0\0\0\0\0", 12}},                       // version, release, on, in, padding
        {36, {"\xFE\xFF\xFF\xFF\1\0\0\0\0\0\x20\x41\0\0\0\0", 16}},  // day, saving, 10.0, padding
        {52, {"\0\0\0\0\0\0\xE0\x3F\0\0\x80\x3F", 12}},              // time zone 0.5, cover 1
        {84, {"\0\0\x80\x3F\0\0\0\0\0\0\0\0", 12}},                  // blue of the sky, padding, overrides
        {104, {"\0\0\0\xC0\0\0\0\x3F\0\5\0\2", 12}},                 // illuminance -2, accuracy 0.5, flags
    };
    for (const auto& c : cases)
        EXPECT_EQ(std::string_view(bytes).substr(c.offset, c.bytes.size()), c.bytes) << c.offset;
}

TEST_F(LightForms, FormsOfOtherReleases) {
    Settings overridden;
    overridden.overrideSolarPosition = true;
    overridden.solarAltitude = 0.5f;
    overridden.solarAzimuth = 1;
    Settings accurate = overridden;
    accurate.skyShadowAccuracy = 0.25f;
    Settings skyCasts = accurate, all = accurate;
    skyCasts.skyCastsShadows = true;
    all.sunCastsShadows = false;
    all.skyFlag3 = true;
    light->setSettings(all);
    const std::string bytes = save(Form::binary), text = save(Form::text);
    const auto textFrom = [&](const char* from, const char* to) {
        return text.substr(text.find(from), text.find(to) - text.find(from));
    };
    const std::string common = textFrom("Natural light is", "Overwrite Solar Position");
    const std::string overrides = textFrom("Overwrite Solar Position", "Sun Flags");
    const std::string accuracy = "Sky Shadows Accuracy: 0.25\n";
    const std::string binaryOverrides = bytes.substr(92, 16), binaryAccuracy = bytes.substr(108, 4);
    const struct {
        std::string header, text;
        char release;
        std::string bytes;
        Settings expected;
    } cases[] = {
        {"1, Release 0", "", 0, "", {}},
        {"1, Release -2", overrides, 0, "", {}},
        {"1, Release 1", overrides, 1, binaryOverrides, overridden},
        {"1, Release 2", overrides + "Sky Casts Shadows: yes\n" + accuracy, 2,
         binaryOverrides + std::string("\0\0", 2) + binaryAccuracy, accurate},
        {"1, Release 2", overrides + "Sky Casts Shadows: Yes\n" + accuracy, 2,
         binaryOverrides + std::string("\0\1", 2) + binaryAccuracy, skyCasts},
        {"1, Release 3", text.substr(text.find("Overwrite")), 3, bytes.substr(92), all},
        {"9, Release 12", text.substr(text.find("Overwrite")) + "More: 1\n", 12, bytes.substr(92), all},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.header);
        light->setLatitude(3);
        EXPECT_TRUE(load("Marovendel Natural Light Version " + c.header + "\n" + common + c.text, Form::text));
        EXPECT_EQ(settings(), c.expected);
        const std::string input = std::string{1, 0, c.release, 0} + bytes.substr(4, 88) + c.bytes;
        for (std::size_t size = 0; size < input.size(); ++size)
            ASSERT_EQ(refusal(input.substr(0, size), Form::binary), "12896 12898 0") << size;
        EXPECT_TRUE(load(input, Form::binary));
        EXPECT_EQ(settings(), c.expected);
    }
    const std::string release2 = "Marovendel Natural Light Version 1, Release 2\n" + common + overrides;
    EXPECT_EQ(refusal(release2 + accuracy, Form::text).substr(0, 11), "12896 12921");
    EXPECT_EQ(refusal(release2 + "Sky Casts Shadows: no\n", Form::text).substr(0, 11), "12896 12924");
    // Texts come and go as a whole, at once.
    const std::wstring texts = Ov::messageFile().fileName();
    const TempFolder folder;
    const std::wstring later = folder.wide("later");
    for (const std::wstring& missing : {std::wstring(), later}) {
        Ov::messageFile().setFileName(missing.c_str());
        EXPECT_EQ(refusal("", Form::binary), "Message 12898.");
    }
    std::filesystem::copy_file(Ov::nativePath(texts), Ov::nativePath(later));
    EXPECT_EQ(refusal("", Form::binary), "12896 12898 0");
    for (const char version : {'\0', '\2'}) {
        light->setLatitude(3);
        EXPECT_TRUE(load({version, 0, 3, 0}, Form::binary));
        EXPECT_EQ(settings(), Settings());
    }
}

}  // namespace
}  // namespace OvPhotometrics
