#include "components/photo/naturallight/calendar.h"

#include <gtest/gtest.h>

#include <climits>
#include <cmath>
#include <limits>
#include <numbers>
#include <set>
#include <string>

#include "components/messageFile/message.h"
#include "components/photo/naturallight/clock.h"
#include "components/photo/naturallight/timeZones.h"
#include "tests/support/messageLog.h"

namespace OvPhotometrics {
namespace {

constexpr float infinity = std::numeric_limits<float>::infinity();
constexpr float notANumber = std::numeric_limits<float>::quiet_NaN();
constexpr float degree = 3.1415927F / 180;

TEST(Calendar, EveryDayOfTheYearIsOneDate) {
    int month = 0, day = 0, lastMonth = 1, lastDay = 0;
    for (int yearDay = 1; yearDay <= 365; ++yearDay) {
        ASSERT_TRUE(monthAndDay(yearDay, &month, &day));
        EXPECT_EQ(dayOfYear(month, day), yearDay);
        const bool newMonth = lastDay == getDaysInMonth(lastMonth);
        EXPECT_EQ(month, newMonth ? lastMonth + 1 : lastMonth) << yearDay;
        EXPECT_EQ(day, newMonth ? 1 : lastDay + 1) << yearDay;
        lastMonth = month;
        lastDay = day;
    }
    EXPECT_EQ(lastMonth, 12);
    EXPECT_EQ(lastDay, 31);
    EXPECT_EQ(dayOfYear(6, 21), 172);
    EXPECT_TRUE(monthAndDay(59, nullptr, &day));
    EXPECT_TRUE(monthAndDay(60, &month, nullptr));
    EXPECT_EQ(day, 28);
    EXPECT_EQ(month, 3);
}

TEST(Calendar, WhatIsNoDateGivesNothing) {
    for (int month : {INT_MIN, -1, 0, 13, INT_MAX}) {
        EXPECT_EQ(dayOfYear(month, 1), 0) << month;
        EXPECT_EQ(getDaysInMonth(month), 0) << month;
        EXPECT_STREQ(getMonthName(month), L"");
        EXPECT_STREQ(getMonthShortName(month), L"");
    }
    for (int day : {INT_MIN, -1, 0, 29, INT_MAX}) EXPECT_EQ(dayOfYear(2, day), 0) << day;
    for (int yearDay : {INT_MIN, -1, 0, 366, INT_MAX}) {
        int month = -7, day = -8;
        EXPECT_FALSE(monthAndDay(yearDay, &month, &day));
        EXPECT_EQ(month, -7);
        EXPECT_EQ(day, -8);
    }
}

/// A reading of the clock as "13:45", with " pm" where that is told.
std::string reading(bool twelveHour, float decimal) {
    int hours = -1, minutes = -1;
    bool pm = false;
    decimalToHoursMinutes(twelveHour, decimal, &hours, &minutes, &pm);
    return std::to_string(hours) + ":" + std::to_string(minutes) + (pm ? " pm" : "");
}

TEST(Clock, EveryMinuteComesBack) {
    for (int minute = 0; minute < 24 * 60; ++minute)
        for (bool twelveHour : {false, true}) {
            const bool pm = twelveHour && minute >= 12 * 60;
            const int hours = minute / 60 - (pm ? 12 : 0);
            EXPECT_EQ(reading(twelveHour, static_cast<float>(minute) / 60),
                      std::to_string(hours) + ":" + std::to_string(minute % 60) + (pm ? " pm" : ""));
            EXPECT_NEAR(hoursMinutesToDecimal(twelveHour, hours, minute % 60, pm), minute / 60.0, 2e-6);
        }
}

TEST(Clock, ReadsAnyHours) {
    const struct {
        float decimal;
        const char* of24;
        const char* of12;
    } cases[] = {
        {13.75F, "13:45", "1:45 pm"}, {-0.5F, "23:30", "11:30 pm"}, {0.25F, "0:15", "0:15"},
        {12, "12:0", "0:0 pm"},       {23.992F, "0:0", "0:0"},      {-0.001F, "0:0", "0:0"},
        {-24, "0:0", "0:0"},          {49.5F, "1:30", "1:30"},      {notANumber, "0:0", "0:0"},
        {infinity, "0:0", "0:0"},     {-infinity, "0:0", "0:0"},    {3e38F, "0:0", "0:0"},
        {0.0083F, "0:0", "0:0"},      {0.0084F, "0:1", "0:1"},      {16777216, "16:0", "4:0 pm"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(reading(false, c.decimal), c.of24) << c.decimal;
        EXPECT_EQ(reading(true, c.decimal), c.of12) << c.decimal;
    }
    bool pm = true;
    decimalToHoursMinutes(false, 1, nullptr, nullptr, &pm);
    EXPECT_TRUE(pm);  // not for a clock of 24 hours
    decimalToHoursMinutes(true, 1, nullptr, nullptr, nullptr);
}

TEST(Clock, TakesAnyReading) {
    EXPECT_EQ(hoursMinutesToDecimal(true, 12, 30, false), 0.5F);
    EXPECT_EQ(hoursMinutesToDecimal(true, 12, 30, true), 12.5F);
    EXPECT_EQ(hoursMinutesToDecimal(false, 23, 60, false), 0);
    EXPECT_EQ(hoursMinutesToDecimal(false, 0, 60 * 50, true), 26);  // taken off once
    EXPECT_EQ(hoursMinutesToDecimal(false, -25, 0, false), -1);
    EXPECT_EQ(hoursMinutesToDecimal(true, -13, 0, true), 11);
    EXPECT_EQ(hoursMinutesToDecimal(false, 1, -30, false), 0.5F);
    EXPECT_FLOAT_EQ(hoursMinutesToDecimal(false, INT_MIN, INT_MIN, false), -35791396.0F);
    EXPECT_FLOAT_EQ(hoursMinutesToDecimal(true, INT_MAX, INT_MAX, true), 35791396.0F);
}

TEST(TimeZones, EveryMeridianFindsTheFirstZoneOfItsOffset) {
    ASSERT_EQ(getTimeZoneCount(), 31);
    for (int i = 0; i < getTimeZoneCount(); ++i) {
        const int found = findTimeZone(getTimeZoneMeridian(i));
        EXPECT_EQ(getTimeZoneMeridian(found), getTimeZoneMeridian(i));
        EXPECT_EQ(getTimeZoneFlag(i), found == i ? 0 : 1) << i;
        EXPECT_LE(found, i);
    }
    EXPECT_FLOAT_EQ(getTimeZoneMeridian(2), 75 * degree);
    EXPECT_EQ(findTimeZone(75 * degree), 2);
    EXPECT_EQ(findTimeZone(-120 * degree), 14);
    EXPECT_EQ(findTimeZone(56.25F * degree), 0);  // as far from 3.5 as from 4
    EXPECT_EQ(findTimeZone(static_cast<float>(-10.5 * std::numbers::pi / 12)), 10);
    EXPECT_EQ(findTimeZone(static_cast<float>(-7.25 * std::numbers::pi / 12)), 16);
    EXPECT_EQ(findTimeZone(1000), 8);
    EXPECT_EQ(findTimeZone(-1000), 9);
    for (float meridian : {infinity, -infinity, notANumber}) EXPECT_EQ(findTimeZone(meridian), 0);
}

TEST(TimeZones, HoldTheirMeridiansAndExcludeTheirBounds) {
    for (int i = 1; i < getTimeZoneCount(); ++i)
        EXPECT_TRUE(isInTimeZone(i, getTimeZoneMeridian(i) / degree)) << i;
    const struct {
        int zone;
        float longitude;
        bool inside;
    } cases[] = {
        {10, -170, true}, {10, 100, false}, {10, 175, false}, {10, 176, true},        {10, -135, false},
        {10, -136, true}, {8, 180, true},   {8, -164, false}, {2, 45, false},         {2, 104, true},
        {2, 105, false},  {11, -179, true}, {11, 180, false}, {2, notANumber, false}, {10, infinity, false},
    };
    for (const auto& c : cases)
        EXPECT_EQ(isInTimeZone(c.zone, c.longitude), c.inside) << c.zone << " " << c.longitude;
    for (int index : {INT_MIN, -1, 31, INT_MAX}) {
        EXPECT_FALSE(isInTimeZone(index, 0));
        EXPECT_EQ(getTimeZoneFlag(index), 0);
        EXPECT_EQ(getTimeZoneMeridian(index), 0);
        EXPECT_STREQ(getTimeZoneName(index), L"");
    }
}

TEST(CalendarNames, AreMessagesOfTheirNumbers) {
    MessageLog log;
    std::set<std::wstring> names;
    for (int month = 1; month <= 12; ++month) {
        names.insert(getMonthName(month));
        names.insert(getMonthShortName(month));
    }
    for (int i = 0; i < getTimeZoneCount(); ++i) names.insert(getTimeZoneName(i));
    EXPECT_EQ(names.size(), 55U);
    EXPECT_EQ(*names.begin(), L"13026");
    EXPECT_EQ(*names.rbegin(), L"13080");
    EXPECT_STREQ(getMonthShortName(5), L"13080");
    EXPECT_STREQ(getTimeZoneName(10), L"13049");

    const wchar_t* march = getMonthName(3);
    getMonthShortName(4);
    getTimeZoneName(5);
    EXPECT_STREQ(march, L"13030");  // valid until the same function is called again

    Ov::messageFile().setFileName(L"/none/Res.dll");
    for (const auto name : {getMonthName, getMonthShortName, getTimeZoneName})
        EXPECT_THROW(name(1), Ov::RnMessageFileEx::ExNoCatalogue);
}

}  // namespace
}  // namespace OvPhotometrics
