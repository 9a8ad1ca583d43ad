#pragma once

#include <algorithm>
#include <stdexcept>
#include <string>

#include "components/support/castImpl.h"
#include "components/support/charInput.h"

/// Bytes behind the operations that every device has and nothing else: no window, raw bytes only a few at a time, and
/// no more pushed back than was read, two characters at most.
class PlainDevice : public Ov::RnCastHeap<Ov::RnCastImpl<Ov::RnBufferedIO, Ov::RnBufferedIO>> {
public:
    explicit PlainDevice(std::string_view bytes = {}) : _bytes(bytes) {}

    const std::string& bytes() const { return _bytes; }

    int readBytes(void* buffer, int count) override {
        const std::size_t part = std::min({static_cast<std::size_t>(count), _bytes.size() - _at, std::size_t{7}});
        _bytes.copy(static_cast<char*>(buffer), part, _at);
        _at += part;
        return static_cast<int>(part);
    }
    void endLine() override { put('\n'); }
    void writeSeparator() override { put(' '); }
    int writeChars(const wchar_t* text, int count) override {
        std::for_each(text, text + count, [this](wchar_t c) { put(c > 255 ? '?' : static_cast<char>(c)); });
        return count;
    }
    void skipSeparator(int count) override {
        _at = std::min(_at + static_cast<std::size_t>(count), _bytes.size());
    }
    int get(wchar_t& c) override {
        _pushed = 0;
        if (_at == _bytes.size()) {
            c = endOfInput;
            return 0;
        }
        c = static_cast<unsigned char>(_bytes[_at++]);
        return 1;
    }
    void unget(wchar_t c) override {
        if (_at == 0 || ++_pushed > 2 || static_cast<unsigned char>(_bytes[_at - 1]) != c)
            throw std::logic_error("pushed back what was not read");
        --_at;
    }
    long seek(long offset, int whence) override {
        const long target = offset + (whence == 0 ? 0 : static_cast<long>(_at));
        if (target < 0 || target > static_cast<long>(_bytes.size())) return -1;
        _at = static_cast<std::size_t>(target);
        return target;
    }

private:
    void put(char c) { _bytes.replace(_at++, 1, 1, c); }

    std::string _bytes;
    std::size_t _at = 0;
    int _pushed = 0;
};
