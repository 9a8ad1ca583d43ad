#pragma once

#include <iosfwd>
#include <string>
#include <string_view>

#include "components/support/castImpl.h"
#include "host/componentManager/bufferedIO.h"
#include "ovphoto/inputWindow.h"

namespace Ov {

// Devices are counted objects: make them with rnCreate.

/// Device over bytes in memory: reads and writes at one position, and grows as it is written.
class RnMemoryBuffer : public RnCastHeap<RnCastImpl2<RnBufferedIO, RnInputWindow, RnBufferedIO>> {
public:
    /// @{
    /// Empty, or holding a copy of `bytes`, at the first of them.
    RnMemoryBuffer() : RnMemoryBuffer(std::string_view()) {}
    explicit RnMemoryBuffer(std::string_view bytes);
    /// @}

    RnMemoryBuffer(const RnMemoryBuffer&) = delete;
    RnMemoryBuffer& operator=(const RnMemoryBuffer&) = delete;

    int readBytes(void* buffer, int count) override;
    void endLine() override;
    void writeSeparator() override;
    int writeChars(const wchar_t* text, int count) override;
    void skipSeparator(int count) override;
    int get(wchar_t& c) override;
    void unget(wchar_t c) override;
    long seek(long offset, int whence) override;

    /// All that is held, wherever the position is.
    const std::string& bytes() const { return _bytes; }

protected:
    /// Appends more input to what is held; false at the end of it. Memory has no more than it holds.
    virtual bool readMore() { return false; }
    /// Adds to what is held; the position stays.
    void append(const char* data, std::size_t count);
    /// Room for `count` bytes at the position, which moves behind them.
    virtual char* prepareWrite(std::size_t count) { return makeRoom(count); }

private:
    std::size_t position() const { return static_cast<std::size_t>(_next - _bytes.data()); }
    void setPosition(std::size_t position);
    char* makeRoom(std::size_t count);
    bool fill() { return _next != _limit || readMore(); }

    std::string _bytes;
};

/// Input device over a standard stream, which must outlive it. It reads ahead in blocks, and keeps what it has
/// read so that `seek` works on any stream. Writing raises ExWriteError.
class RnInBuffer : public RnMemoryBuffer {
public:
    /// Reads from `source`.
    explicit RnInBuffer(std::istream* source);

protected:
    bool readMore() override;
    char* prepareWrite(std::size_t count) override;

private:
    std::istream* _source;
};

/// Output device over a standard stream, which must outlive it. Writes at once; at the end of its input always.
class RnOutBuffer : public RnCastHeap<RnCastImpl<RnBufferedIO, RnBufferedIO>> {
public:
    /// Writes to `sink`.
    explicit RnOutBuffer(std::ostream* sink) : _sink(sink) {}

    int readBytes(void* buffer, int count) override;
    void endLine() override;
    void writeSeparator() override;
    int writeChars(const wchar_t* text, int count) override;
    void skipSeparator(int count) override;
    int get(wchar_t& c) override;
    void unget(wchar_t c) override;
    long seek(long offset, int whence) override;

private:
    void write(const char* bytes, std::size_t count);

    std::ostream* _sink;
    long _written = 0;
};

}  // namespace Ov
