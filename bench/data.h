#pragma once

#include <cstdio>
#include <random>
#include <string>
#include <vector>

// Generated inputs of fixed seed.

namespace bench {

/// An IES file, type C: vertical angles 0 to 180, planes 0 to 360 or, open, up to the last before 360. Values have
/// one or two decimals; lines run to 130 characters.
inline std::string iesText(int verticalCount, int horizontalCount, bool closed) {
    std::mt19937 random(1);
    std::uniform_real_distribution<double> candela(0, 2500);
    std::string text = "IESNA:LM-63-2002\n[TEST] generated\n[MANUFAC] none\nTILT=NONE\n1 -1 1 " +
                       std::to_string(verticalCount) + " " + std::to_string(horizontalCount) +
                       " 1 2 0 0 0\n1 1 100\n";
    std::size_t lineStart = text.size();
    const auto add = [&](const char* format, double value) {
        char number[32];
        const auto length = static_cast<std::size_t>(std::snprintf(number, sizeof number, format, value));
        if (text.size() + length + 1 - lineStart > 130) {
            text += '\n';
            lineStart = text.size();
        }
        text.append(number, length) += ' ';
    };
    for (int i = 0; i < verticalCount; ++i) add("%.4g", 180.0 * i / (verticalCount - 1));
    const int gaps = closed ? horizontalCount - 1 : horizontalCount;
    for (int j = 0; j < horizontalCount; ++j) add("%.4g", 360.0 * j / gaps);
    for (int k = 0; k < verticalCount * horizontalCount; ++k) add(k % 2 ? "%.1f" : "%.2f", candela(random));
    return text;
}

struct Direction {
    float theta, psi;
};

/// Directions spread evenly over theta and psi.
inline std::vector<Direction> directions(std::size_t count) {
    std::mt19937 random(2);
    std::uniform_real_distribution<float> theta(0, 3.1415926f), psi(0, 6.283185f);
    std::vector<Direction> result(count);
    for (Direction& d : result) d = {theta(random), psi(random)};
    return result;
}

}  // namespace bench
