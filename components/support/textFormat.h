#pragma once

#include <cstdint>
#include <string>

// The conversions of printf over wide text, one at a time, independent of any locale. Callers read the format.

namespace Ov {

/// What stands between the percent sign and the conversion letter.
struct Directive {
    bool left = false;       // '-'
    bool plus = false;       // '+'
    bool blank = false;      // ' '
    bool alternate = false;  // '#'
    bool zeros = false;      // '0'
    int width = 0;
    int precision = -1;    // -1: none given
    wchar_t modifier = 0;  // 'h', 'l', 'L' or none
    wchar_t letter = 0;
    bool widthIsArgument = false;      // '*': the caller fetches it and sets `width`
    bool precisionIsArgument = false;  // '.*'
};

/// Reads flags, width, precision, modifier and letter from `text`, which starts behind the percent sign and ends
/// at `end`. The position behind the letter, or null when the text ends first or a width or precision exceeds
/// maxFormatWidth.
const wchar_t* parseDirective(const wchar_t* text, const wchar_t* end, Directive& directive);

inline constexpr int maxFormatWidth = 4096;

/// Append one converted value. Letters: d i u x X o c C (integers, 32 bits, or 16 with modifier h), e E f F g G
/// (correctly rounded), s.
void appendInteger(std::wstring& out, const Directive& directive, std::int32_t value);
void appendDouble(std::wstring& out, const Directive& directive, double value);
void appendText(std::wstring& out, const Directive& directive, const wchar_t* text);

}  // namespace Ov
