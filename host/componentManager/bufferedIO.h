#pragma once

#include "host/componentManager/castable.h"

namespace Ov {

/// The character device behind a stream. One byte is one character, value for value (0 to 255), both ways; a
/// character above 255 is written as "?". A device that holds bytes ready may answer RnInputWindow, too.
///
/// Errors: a device whose source fails raises RnStreamEx::ExReadError, one whose sink fails ExWriteError.
class OVHOST_API RnBufferedIO : public RnCastable {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0x81c8df23, 0xa78111d1, 0x988a4445, 0x53540000};
    /// What `get` leaves in its argument at the end of the input.
    static constexpr wchar_t endOfInput = 0xFFFF;

    /// Reads up to `count` raw bytes; the number read, 0 at the end.
    virtual int readBytes(void* buffer, int count) = 0;
    /// Writes a line feed.
    virtual void endLine() = 0;
    /// Writes one blank.
    virtual void writeSeparator() = 0;
    /// Writes `count` characters; the number written.
    virtual int writeChars(const wchar_t* text, int count) = 0;
    /// Skips up to `count` characters of the input.
    virtual void skipSeparator(int count) = 0;
    /// Reads one character; below 1 at the end of the input, with `c` = endOfInput.
    virtual int get(wchar_t& c) = 0;
    /// Pushes a character back, so that the next `get` returns it; two in a row are possible. endOfInput at the
    /// end of the input changes nothing.
    virtual void unget(wchar_t c) = 0;
    /// Moves to `offset` from the start (whence 0) or from the current position (whence 1) and returns the new
    /// position; -1 where that cannot be done. seek(0, 1) tells the position.
    virtual long seek(long offset, int whence) = 0;
};

}  // namespace Ov
