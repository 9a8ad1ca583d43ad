#pragma once

#include "host/componentManager/castable.h"

namespace Ov {

/// The character device behind a stream. One byte is one character, value for value (0 to 255), both ways; a
/// character above 255 is written as "?".
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
    /// Writes raw bytes; the number written.
    virtual int writeBytes(const void* data, int count) = 0;
    /// Line feeds between the start and the current position.
    virtual int lineFeeds() = 0;

    /// @{
    /// The unread bytes that the device holds ready, possibly none. A reader may walk them directly and says with
    /// `advanceTo` how far it came; what it does not find there it gets through `get`.
    const char* next() const { return _next; }
    const char* limit() const { return _limit; }
    void advanceTo(const char* position) { _next = position; }
    /// @}

    /// As `get`, but the result is the character or -1, and a character that is ready costs no call.
    int getChar() {
        if (_next != _limit) return static_cast<unsigned char>(*_next++);
        wchar_t c;
        return get(c) < 1 ? -1 : static_cast<int>(c);
    }

protected:
    /// @{
    /// What `next` and `limit` give, kept by the device.
    const char* _next = nullptr;
    const char* _limit = nullptr;
    /// @}
};

}  // namespace Ov
