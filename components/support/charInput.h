#pragma once

#include <algorithm>

#include "host/componentManager/bufferedIO.h"
#include "ovphoto/inputWindow.h"

namespace Ov {

/// Reads raw bytes, however few the device gives at a time; fewer than `count` only at the end of the input.
inline int rnReadBytes(RnBufferedIO& device, void* buffer, int count) {
    int done = 0;
    for (int part = 1; done < count && part > 0; done += part)
        part = std::max(device.readBytes(static_cast<char*>(buffer) + done, count - done), 0);
    return done;
}

/// Reads a device character by character: those of its window where it has one, others by its operations. The
/// device's own position is that of the reading, between any two calls.
///
/// Errors: those of the device.
class RnCharInput {
public:
    /// Keeps the device, and asks it for its window.
    explicit RnCharInput(RnBufferedIO& device)
        : _device(RnRef<RnBufferedIO>::share(&device)), _window(rnQuery<RnInputWindow>(&device)) {}

    /// The device, without a new reference.
    RnBufferedIO& device() const { return *_device; }

    /// The next character, or -1 at the end of the input.
    int getChar() {
        if (next() != limit()) {
            const char* const here = next();
            advanceTo(here + 1);
            return static_cast<unsigned char>(*here);
        }
        wchar_t c = 0;
        return _device->get(c) < 1 ? -1 : static_cast<int>(c);
    }
    /// The character that `getChar` would give, which stays.
    int peekChar() {
        if (next() != limit()) return static_cast<unsigned char>(*next());
        const int c = getChar();
        ungetChar(c);
        return c;
    }
    /// Pushes back what `getChar` gave, up to two in a row; -1 changes nothing.
    void ungetChar(int c) {
        if (c >= 0) _device->unget(static_cast<wchar_t>(c));
    }
    /// Takes characters for as long as `takes` says so of the next one; that which stays ahead, or -1.
    template <class Takes>
    int takeWhile(Takes takes) {
        for (;;) {
            const char* p = next();
            const char* const end = limit();
            while (p != end && takes(static_cast<unsigned char>(*p))) ++p;
            if (p != next()) advanceTo(p);
            if (p != end) return static_cast<unsigned char>(*p);
            const int c = getChar();
            if (c >= 0 && takes(c)) continue;
            ungetChar(c);
            return c;
        }
    }

    /// @{
    /// The device's window; without one it is empty.
    const char* next() const { return _window ? _window->next() : nullptr; }
    const char* limit() const { return _window ? _window->limit() : nullptr; }
    void advanceTo(const char* position) {
        if (_window) _window->advanceTo(position);
    }
    /// @}

private:
    RnRef<RnBufferedIO> _device;
    RnRef<RnInputWindow> _window;
};

}  // namespace Ov
