#include "components/photo/naturallight/calendar.h"

#include <cstdint>

#include "components/messageFile/message.h"
#include "components/messageFile/messageIds.h"

namespace OvPhotometrics {

namespace {

struct Month {
    Ov::Message<> name;
    Ov::Message<> shortName;
    std::int32_t days;
    std::int32_t daysBefore;
};

constexpr Month months[monthsInYear] = {
    {messages::monthJanuary, messages::monthJanuaryShort, 31, 0},
    {messages::monthFebruary, messages::monthFebruaryShort, 28, 31},
    {messages::monthMarch, messages::monthMarchShort, 31, 59},
    {messages::monthApril, messages::monthAprilShort, 30, 90},
    {messages::monthMay, messages::monthMayShort, 31, 120},
    {messages::monthJune, messages::monthJuneShort, 30, 151},
    {messages::monthJuly, messages::monthJulyShort, 31, 181},
    {messages::monthAugust, messages::monthAugustShort, 31, 212},
    {messages::monthSeptember, messages::monthSeptemberShort, 30, 243},
    {messages::monthOctober, messages::monthOctoberShort, 31, 273},
    {messages::monthNovember, messages::monthNovemberShort, 30, 304},
    {messages::monthDecember, messages::monthDecemberShort, 31, 334},
};

/// The row of a month 1..12, or null.
const Month* findMonth(int month) { return month >= 1 && month <= monthsInYear ? &months[month - 1] : nullptr; }

const wchar_t* monthText(int month, Ov::Message<> Month::*message) {
    const Month* row = findMonth(month);
    return row ? Ov::keptText(row->*message) : L"";
}

}  // namespace

int getDaysInMonth(int month) {
    const Month* row = findMonth(month);
    return row ? row->days : 0;
}

int dayOfYear(int month, int day) {
    const Month* row = findMonth(month);
    return row && day >= 1 && day <= row->days ? row->daysBefore + day : 0;
}

bool monthAndDay(int yearDay, int* month, int* day) {
    if (yearDay < 1 || yearDay > daysInYear) return false;
    int found = 1;
    while (found < monthsInYear && yearDay > months[found].daysBefore) ++found;
    if (month) *month = found;
    if (day) *day = yearDay - months[found - 1].daysBefore;
    return true;
}

const wchar_t* getMonthName(int month) { return monthText(month, &Month::name); }

const wchar_t* getMonthShortName(int month) { return monthText(month, &Month::shortName); }

}  // namespace OvPhotometrics
