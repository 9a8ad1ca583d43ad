#pragma once

#include <cstdint>
#include <string>

#include "components/support/streamText.h"

namespace OvPhotometrics {

enum class TbtToken {
    number,    // digits, fraction and exponent, no sign
    zeroFill,  // "Z0" or "z0"
    end,       // "-1"
    endOfFile,
    other,  // any other character, or a number of more than 80
};

/// Takes TBT text apart: a title line, then tokens between white space and /* comments */. A comment that is not
/// closed ends the input.
class TbtTokenizer {
public:
    explicit TbtTokenizer(Ov::RnStream& in) : _in(in) {}

    /// The rest of the line with the next token: up to 80 characters, those behind them dropped.
    std::wstring readTitle();
    TbtToken next();

    TbtToken kind() const { return _kind; }
    /// The text of the current token, up to 80 characters of it.
    std::wstring text() const;
    /// The value of the current token. False for one that is no number. What is too large is infinite, what is too
    /// small 0.
    bool number(float& value) const;
    /// The whole number that the current token starts with. False, with the largest, when that is too large.
    bool integer(std::int32_t& value) const;

    /// Line feeds consumed so far.
    std::int32_t lineFeeds() const;

private:
    int take();
    void takeToken();
    void add(int c);
    bool takeIf(char c);
    bool takeReadyNumber();
    TbtToken takeNumber();
    TbtToken takeMark();
    int skipBlank();
    bool skipComment();

    Ov::RnStreamInput _in;
    std::int64_t _lineFeeds = 0;
    TbtToken _kind = TbtToken::endOfFile;
    std::string _text;
    bool _tooLong = false;
};

}  // namespace OvPhotometrics
