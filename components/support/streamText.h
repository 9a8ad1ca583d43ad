#pragma once

#include "components/support/charInput.h"
#include "host/componentManager/stream.h"

// Characters of a stream's device, as the stream counts them: a separator that is due, and the column of the output.

namespace Ov {

/// Reads a stream character by character. A separator that is due is skipped first.
///
/// Errors: those of the device.
class RnStreamInput {
public:
    /// Keeps the stream's device.
    explicit RnStreamInput(RnStream& stream) : _stream(stream), _chars(stream.device()) {}

    /// The characters, from where the next one is read.
    RnCharInput& chars() {
        if (_stream.pendingSeparator) skipSeparator();
        return _chars;
    }
    /// @{
    /// As those of RnCharInput.
    int getChar() { return chars().getChar(); }
    int peekChar() { return chars().peekChar(); }
    void ungetChar(int c) { _chars.ungetChar(c); }
    /// @}

private:
    void skipSeparator() {
        _stream.pendingSeparator = false;
        _chars.device().skipSeparator(1);
    }

    RnStream& _stream;
    RnCharInput _chars;
};

/// Ends the current output line.
inline void endLine(RnStream& out) {
    out.device().endLine();
    out.column = 0;
    out.pendingSeparator = false;
}

/// Writes a run of characters that stands for one item of a list, after the separator that is due: a line end where
/// the line is past column 70, else a blank.
inline void writeItem(RnStream& out, const wchar_t* text, int count) {
    constexpr std::int32_t lastColumn = 70;
    if (out.pendingSeparator && out.column > lastColumn) {
        endLine(out);
    } else if (out.pendingSeparator) {
        out.device().writeSeparator();
        ++out.column;
    }
    out.pendingSeparator = false;
    out.column += out.device().writeChars(text, count);
}

}  // namespace Ov
