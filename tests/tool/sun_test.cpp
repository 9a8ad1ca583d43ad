#include <gtest/gtest.h>

#include <cmath>

#include "tool/toolRun.h"

namespace {

constexpr double degree = 3.14159265358979 / 180;

class ToolSun : public testing::Test {
protected:
    ToolResult run(const std::string& arguments) { return runTool(arguments, folder); }
    nlohmann::ordered_json json(const std::string& arguments) {
        const auto objects = run(arguments + " --json").json();
        return objects.empty() ? nlohmann::ordered_json() : objects.front();
    }
    std::string bytes(const std::string& name) { return readBytes(folder.path() / name); }

    TempFolder folder;
};

TEST_F(ToolSun, TheDefaultObjectHasItsSolarTime) {
    const auto sun = json("sun");
    const double equation =
        0.17 * std::sin(4 * 180 * degree * 92 / 373) - 0.129 * std::sin(2 * 180 * degree * 164 / 355);
    EXPECT_NEAR(sun["solarTime"].get<double>(), 9 + equation + 4 / 60.0, 2e-6);
    EXPECT_EQ(sun["maxDirectNormalIlluminance"], 131835);
    EXPECT_EQ(sun.size(), 22U);
    for (const char* angle : {"Altitude", "Azimuth", "Zenith"}) {
        const std::string key = std::string("solar") + angle;
        EXPECT_NEAR(sun[key].get<double>(), sun[key + "Degrees"].get<double>() * degree, 2e-7) << key;
    }
    const ToolResult text = run("sun");
    EXPECT_TRUE(text.says("0 is south, positive towards west")) << text.out;
    EXPECT_TRUE(text.says("lux") && text.says("cd/m2") && text.says("9:03")) << text.out;
}

TEST_F(ToolSun, EveryOptionReachesTheObject) {
    const std::string all =
        "settings write all.txt --latitude 33.9s --longitude 151.2E --north 12.5 --date 12-21 --time 10:30"
        " --time-zone -10 --daylight-saving no --sky-cover 0.5 --sun-position 45,-90 --illuminance 50000";
    ASSERT_EQ(run(all).status, 0);
    const auto settings = json("settings show all.txt");
    const std::pair<const char*, double> wanted[] = {{"latitude", -33.9 * degree},
                                                     {"longitude", -151.2 * degree},
                                                     {"north", 12.5 * degree},
                                                     {"day", 355},
                                                     {"localTime", 10.5},
                                                     {"timeZone", -150 * degree},
                                                     {"skyCover", 0.5},
                                                     {"solarAltitude", 45 * degree},
                                                     {"solarAzimuth", -90 * degree},
                                                     {"directNormalIlluminance", 5e4}};
    for (const auto& [key, value] : wanted) EXPECT_NEAR(settings[key].get<double>(), value, 3e-7) << key;
    EXPECT_TRUE(settings["overrideSolarPosition"]);
    EXPECT_FALSE(settings["daylightSaving"]);
    // Other spellings of the same; a given solar time is saved as the local time that follows from it.
    const std::string other = "settings write other.txt --from all.txt --latitude -33.9 --day 355 --solar-time ";
    const double solarTime = json("sun --from all.txt")["solarTime"].get<double>();
    ASSERT_EQ(run(other + std::to_string(solarTime)).status, 0);
    EXPECT_NEAR(json("settings show other.txt")["localTime"].get<double>(), 10.5, 2e-6);
    EXPECT_EQ(json("sun --from all.txt")["directNormalIlluminance"], 50000);
}

TEST_F(ToolSun, SavedFormsAreToldApartAndGiveTheSameSettings) {
    ASSERT_EQ(
        run("settings write a.txt --latitude 12.34 --longitude 3 --time-zone 0 --time 7.7 --sky-cover 0.1").status,
        0);
    ASSERT_EQ(run("settings write b.bin --binary --from a.txt").status, 0);
    ASSERT_EQ(run("settings write c.txt --from b.bin").status, 0);
    EXPECT_EQ(bytes("a.txt"), bytes("c.txt"));
    EXPECT_EQ(bytes("b.bin").size(), 116U);
    folder.write("blanks.txt", "\n \t" + bytes("a.txt"));
    EXPECT_EQ(json("settings show blanks.txt"), json("settings show b.bin"));
    EXPECT_TRUE(run("settings show a.txt").says("12.34 deg N"));

    std::string other = bytes("b.bin");
    other[0] = 2;
    folder.write("other.bin", other);
    EXPECT_TRUE(run("settings show other.bin").says("other.bin: of an unknown version"));
    EXPECT_EQ(json("settings show other.bin")["day"], 172);
}

TEST_F(ToolSun, RefusedFilesAreToldAndNothingIsWritten) {
    run("settings write good.txt");
    run("settings write good.bin --binary");
    folder.write("old.txt", "old");
    folder.write("letter.txt", "Dear reader,\n");
    folder.write("cut.txt", bytes("good.txt").substr(0, 100));
    folder.write("cut.bin", bytes("good.bin").substr(0, 50));
    folder.write("empty", "");
    for (const char* file : {"letter.txt", "cut.txt", "cut.bin", "empty", "missing", "."}) {
        for (std::string command : {"settings show @", "settings show @ --json", "sun --from @ --json",
                                    "sky --normal 0,0,1 --from @", "settings write old.txt --from @"}) {
            const ToolResult result = run(command.replace(command.find('@'), 1, file));
            EXPECT_EQ(result.status, 1) << command;
            EXPECT_TRUE(result.err.starts_with(std::string(file) + ": ")) << command << result.err;
        }
    }
    EXPECT_EQ(bytes("old.txt"), "old");
    EXPECT_EQ(run("settings write .").status, 1);
}

TEST_F(ToolSun, WrongArgumentsGiveStatus2) {
    const std::pair<std::string, std::vector<const char*>> options[] = {
        {"--latitude", {"nan", "N", "-4N", "40.7W", "3", "3 --longitude 4"}},
        {"--longitude", {"4,5"}},
        {"--date", {"2-29", "13-1", "6-0", "6/21", "100-1", "2026-2-29", "2028-02-29", "26-06-21"}},
        {"--day", {"1.5", "70000", "1 --date 1-1"}},
        {"--time", {"25", "-1", "24:01", "10:5", "1e39", "10:60", "8 --solar-time 9"}},
        {"--solar-time", {"24.5"}},
        {"--time-zone", {"3"}},
        {"--latitude 3 --longitude 4 --time-zone", {"EST", "+1", "UTC1", "UTC+15"}},
        {"--sky-cover", {"inf"}},
        {"--daylight-saving", {"1"}},
        {"--sun-position", {"10", "1,2,3", "1,"}},
        {"--illuminance", {"-1"}}};
    for (const auto& [option, values] : options)
        for (const char* value : values)
            EXPECT_EQ(run("sun " + option + " " + value).status, 2) << option << " " << value;
    for (const char* arguments : {"sky", "sky --zenith 3", "sky --zenith -3 --azimuth 4", "sky --azimuth 3",
                                  "sky --zenith 3 --azimuth 4 --normal 0,0,1", "settings", "sky --normal 0,0,0",
                                  "settings frob x", "settings write", "sun --day-table --year-table"}) {
        EXPECT_EQ(run(arguments).status, 2) << arguments;
    }
}

TEST_F(ToolSun, SkyAnswersForDirectionsAndSurfaces) {
    const auto sun = json("sun");
    const auto at = [&](double zenith, double azimuth) {
        return json("sky --zenith " + std::to_string(zenith) + " --azimuth " +
                    std::to_string(azimuth))["luminance"]
            .get<double>();
    };
    EXPECT_NEAR(at(0, 0) / sun["zenithLuminance"].get<double>(), 1, 1e-5);
    const double sunAzimuth = sun["solarAzimuth"].get<double>() / degree;
    EXPECT_NEAR(at(30, sunAzimuth + 20) / at(30, sunAzimuth - 20), 1, 1e-4);
    EXPECT_GT(at(30, sunAzimuth), at(30, sunAzimuth + 180));
    EXPECT_EQ(at(91, 0), 0);
    const auto level = json("sky --normal 0,0,1")["illuminance"];
    EXPECT_NEAR(level.get<double>() / sun["skyHorizontalIlluminance"].get<double>(), 1, 0.01);
    EXPECT_EQ(json("sky --normal 0,0,4")["illuminance"], level);
    EXPECT_TRUE(run("sky --zenith 30 --azimuth 0").says("0 is south, positive towards west"));
    EXPECT_TRUE(run("sky --normal 0,0,1 --latitude 95 --longitude 0 --time-zone 0").says("computed with 90 deg"));
}

TEST_F(ToolSun, TablesHaveARowForEachHourAndMonth) {
    const auto day = run("sun --day-table --json").json();
    ASSERT_EQ(day.size(), 24U);
    EXPECT_EQ(day[10], json("sun"));
    const std::string north = " --latitude 70N --longitude 20E --time-zone UTC+1";
    const auto year = run("sun --year-table --json" + north).json();
    ASSERT_EQ(year.size(), 12U);
    EXPECT_EQ(year[5]["sunrise"], json("sun" + north)["sunrise"]);
    EXPECT_EQ(year[5]["site"], json("sun" + north)["site"]);
    const ToolResult text = run("sun --year-table" + north);
    EXPECT_TRUE(text.says("the sun stays up") && text.says("the sun stays down")) << text.out;
    EXPECT_TRUE(run("sun --day-table").says("0 is south, positive towards west"));
}

TEST_F(ToolSun, ZonesAndMonthsAreListed) {
    const auto zones = run("zones --json").json();
    ASSERT_EQ(zones.size(), 31U);
    EXPECT_EQ(zones[12]["offset"], -9.5);
    EXPECT_NEAR(zones[2]["meridian"].get<double>(), 75 * degree, 3e-7);
    const auto months = run("months --json").json();
    ASSERT_EQ(months.size(), 12U);
    EXPECT_EQ(months[11]["firstDay"].get<int>() + months[11]["days"].get<int>(), 366);
    EXPECT_TRUE(run("zones").says("UTC+9:30")) << "west is negative there";
}

/// Signs are those of the form: bare hours count towards west, those behind UTC towards east.
TEST_F(ToolSun, SitesAreWrittenAsPeopleWriteThem) {
    const std::pair<const char*, double> zones[] = {{"-1", -1},           {"5", 5},
                                                    {"UTC", 0},           {"UTC+1", -1},
                                                    {"utc-5", 5},         {"GMT+5:30", -5.5},
                                                    {"UTC-3.5", 3.5},     {"UTC+9:30", -9.5},
                                                    {"UTC+14", -14},      {"'Central European Time'", -1},
                                                    {"'eastern time'", 5}};
    for (const auto& [zone, hours] : zones) {
        const auto sun =
            json("sun --latitude 52.5 --longitude 13.4O --date 2026-06-21 --time-zone " + std::string(zone));
        EXPECT_EQ(sun["site"]["timeZoneHours"], hours) << zone;
        EXPECT_EQ(sun["site"]["longitudeDegrees"].get<float>(), -13.4F);
        EXPECT_EQ(sun["day"], 172);
    }
    run("settings write berlin --latitude 52.5 --longitude 13.4E --time-zone -1");
    EXPECT_EQ(json("sun --from berlin --latitude 50")["site"]["latitudeDegrees"], 50);
    EXPECT_EQ(run("sun --from berlin").err, "");
    for (const char* command : {"sun", "sky --normal 0,0,1", "settings write defaults"})
        EXPECT_EQ(run(command).err, "note: no site is given; taken is 41 deg N, 74 deg W, UTC-5:00\n") << command;
}

TEST_F(ToolSun, GermanOutputIsGermanThroughout) {
    run("settings write saved --latitude 95 --longitude 13.4E --time-zone -1 --sun-position 45,-90");
    for (const char* command :
         {"sun", "sun --day-table", "sun --year-table", "sky --normal 0,0,1", "sky --zenith 30 --azimuth 0",
          "settings show saved", "sun --from saved", "zones", "months"}) {
        const ToolResult german = runShell(std::string("LC_ALL=de_DE.UTF-8 ovphoto ") + command, folder);
        EXPECT_EQ(german.status, 0) << command;
        std::string text = german.out + german.err;
        for (char& c : text) c = c == '\n' || c == ',' || c == ';' || c == ':' ? ' ' : c;
        for (const char* word : {" the ",  " is ",  " sun ",   " sky ",   " deg ",     " lux ", " time ",
                                 " day ",  " by ",  " clock ", " north ", " from ",    " E ",   " name ",
                                 " Time ", " yes ", " no ",    " cover ", " azimuth ", " with "})
            EXPECT_EQ(text.find(word), std::string::npos) << command << word << text;
    }
    const std::string months = runShell("LC_ALL=de_DE.UTF-8 ovphoto months", folder).out;
    EXPECT_NE(months.find("    3  März       Mär     31"), std::string::npos) << months;  // columns of characters
}

}  // namespace
