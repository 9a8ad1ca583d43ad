#include "tools/ovphoto/numbers.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

using namespace OvTool;

TEST(ToolDegrees, EveryAngleOfAFileComesBackAsWritten) {
    // Files hold degrees with up to three decimals; each is read into a float first.
    for (int i = -360000; i <= 360000; i += 7) {
        const float written = static_cast<float>(i / 1000.0);
        EXPECT_EQ(toRadians(toDegrees(toRadians(written))), toRadians(written)) << written;
        EXPECT_NEAR(toDegrees(toRadians(written)), written, 1e-7 * (1 + std::abs(written)));
    }
    EXPECT_EQ(toDegrees(toRadians(22.5F)), 22.5F);
    EXPECT_EQ(toDegrees(3.1415927F), 180);
    EXPECT_TRUE(std::isnan(toDegrees(std::numeric_limits<float>::quiet_NaN())));
}

TEST(ToolNumbers, OnlyWholeFiniteDecimalNumbersAreRead) {
    EXPECT_EQ(parseFloat("-0.5e2"), -50);
    for (const char* text : {"", "-", "1 ", " 1", "1,5", "nan", "inf", "0x10", "1e99", "ten"}) {
        EXPECT_FALSE(parseFloat(text)) << text;
    }
}

TEST(ToolNumbers, ShortNumbersKeepFiveDigits) {
    const std::pair<double, const char*> cases[] = {
        {0, "0"},
        {1, "1"},
        {99.99951, "100"},
        {1234.56, "1234.6"},
        {123456.7, "123457"},
        {-2.5, "-2.5"},
        {0.012345, "0.01235"},
        {1e-7, "1e-07"},
        {2.5e12, "2.5e+12"},
        {0.5, "0.5"},
    };
    for (const auto& [value, text] : cases) EXPECT_EQ(shortNumber(value), text);
}
