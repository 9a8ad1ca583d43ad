#include "tools/numbers/numbers.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>

using namespace OvTool;

TEST(ToolNumbers, EveryAngleOfAFileComesBackAsWritten) {
    // Files hold degrees with up to three decimals; each is read into a float first.
    for (int i = -360000; i <= 360000; i += 7) {
        const float written = static_cast<float>(i / 1000.0);
        EXPECT_EQ(toRadians(static_cast<float>(toDegrees(toRadians(written)))), toRadians(written)) << written;
        EXPECT_NEAR(toDegrees(toRadians(written)), written, 1e-7 * (1 + std::abs(written)));
    }
    EXPECT_EQ(toDegrees(toRadians(22.5F)), 22.5);
    // Some angles are not those of any float in degrees.
    for (float radians = 0.027F; radians < 6.28F; radians = std::nextafter(radians + 0.01F, 7.0F)) {
        const double degrees = toDegrees(radians);
        EXPECT_TRUE(static_cast<float>(degrees * std::numbers::pi / 180) == radians ||
                    toRadians(static_cast<float>(degrees)) == radians)
            << radians;
    }
    EXPECT_EQ(toDegrees(3.1415927F), 180);
    EXPECT_TRUE(std::isnan(toDegrees(std::numeric_limits<float>::quiet_NaN())));
}

TEST(ToolNumbers, WholeFiniteDecimalsAreReadAndFiveDigitsShown) {
    EXPECT_EQ(parseFloat("-0.5e2"), -50);
    for (const char* text : {"", "-", "1 ", " 1", "1,5", "nan", "inf", "0x10", "1e99"})
        EXPECT_FALSE(parseFloat(text)) << text;
    for (const auto& [value, text] :
         {std::pair{0.0, "0"}, std::pair{99.99951, "100"}, std::pair{1234.56, "1234.6"},
          std::pair{123456.7, "123457"}, std::pair{-2.5, "-2.5"}, std::pair{0.012345, "0.01235"},
          std::pair{1e-7, "1e-07"}, std::pair{2.5e12, "2.5e+12"}})
        EXPECT_EQ(shortNumber(value), text);
}
