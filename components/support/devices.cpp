#include "components/support/devices.h"

#include <algorithm>
#include <cstring>
#include <istream>
#include <limits>
#include <ostream>

#include "host/componentManager/streamEx.h"

namespace Ov {

namespace {

constexpr const char* devicesSource = "components/support/devices";
constexpr std::size_t blockSize = 16384;

char narrow(wchar_t c) { return static_cast<std::uint32_t>(c) > 255 ? '?' : static_cast<char>(c); }

std::size_t sizeOf(int count) { return static_cast<std::size_t>(std::max(count, 0)); }

}  // namespace

RnMemoryBuffer::RnMemoryBuffer(std::string_view bytes) : _bytes(bytes) { setPosition(0); }

void RnMemoryBuffer::setPosition(std::size_t position) {
    _next = _bytes.data() + position;
    _limit = _bytes.data() + _bytes.size();
}

void RnMemoryBuffer::append(const char* data, std::size_t count) {
    const std::size_t here = position();
    _bytes.append(data, count);
    setPosition(here);
}

char* RnMemoryBuffer::makeRoom(std::size_t count) {
    const std::size_t here = position();
    if (count > _bytes.size() - here) _bytes.resize(here + count);
    setPosition(here + count);
    return _bytes.data() + here;
}

int RnMemoryBuffer::readBytes(void* buffer, int count) {
    const std::size_t wanted = sizeOf(count);
    while (static_cast<std::size_t>(_limit - _next) < wanted && readMore()) {
    }
    const std::size_t taken = std::min(wanted, static_cast<std::size_t>(_limit - _next));
    if (taken > 0) std::memcpy(buffer, _next, taken);
    _next += taken;
    return static_cast<int>(taken);
}

void RnMemoryBuffer::endLine() { *prepareWrite(1) = '\n'; }
void RnMemoryBuffer::writeSeparator() { *prepareWrite(1) = ' '; }

int RnMemoryBuffer::writeChars(const wchar_t* text, int count) {
    const std::size_t length = sizeOf(count);
    std::transform(text, text + length, prepareWrite(length), narrow);
    return static_cast<int>(length);
}

void RnMemoryBuffer::skipSeparator(int count) {
    for (; count > 0 && fill(); --count) ++_next;
}

int RnMemoryBuffer::get(wchar_t& c) {
    if (!fill()) {
        c = endOfInput;
        return 0;
    }
    c = static_cast<unsigned char>(*_next++);
    return 1;
}

void RnMemoryBuffer::unget(wchar_t c) {
    if (c == endOfInput) return;
    if (position() == 0) {
        _bytes.insert(_bytes.begin(), narrow(c));
        return setPosition(0);
    }
    --_next;
    if (*_next == narrow(c)) return;
    *makeRoom(1) = narrow(c);
    --_next;
}

long RnMemoryBuffer::seek(long offset, int whence) {
    const long base = whence == 0 ? 0 : static_cast<long>(position());
    if ((whence != 0 && whence != 1) || offset < -base || offset > std::numeric_limits<long>::max() - base)
        return -1;
    const auto target = static_cast<std::size_t>(base + offset);
    while (target > _bytes.size() && readMore()) {
    }
    if (target > _bytes.size()) return -1;
    setPosition(target);
    return base + offset;
}

RnInBuffer::RnInBuffer(std::istream* input) : _source(input) {}

char* RnInBuffer::prepareWrite(std::size_t) {
    throw RnStreamEx::ExWriteError(devicesSource, __LINE__, "input stream");
}

bool RnInBuffer::readMore() {
    if (_source->eof()) return false;
    char block[blockSize];
    std::streamsize count = 0;
    try {
        _source->read(block, sizeof block);
        count = _source->gcount();
    } catch (const std::ios_base::failure&) {
        // A stream that raises exceptions does so at its end, too.
        if (!_source->eof() || _source->bad()) throw;
        count = _source->gcount();
    }
    if (_source->bad() || (_source->fail() && !_source->eof())) {
        throw RnStreamEx::ExReadError(devicesSource, __LINE__, "input stream");
    }
    append(block, static_cast<std::size_t>(count));
    return count > 0;
}

void RnOutBuffer::write(const char* bytes, std::size_t count) {
    if (!_sink->write(bytes, static_cast<std::streamsize>(count))) {
        throw RnStreamEx::ExWriteError(devicesSource, __LINE__, "output stream");
    }
    _written += static_cast<long>(count);
}

int RnOutBuffer::writeChars(const wchar_t* text, int count) {
    const std::size_t length = sizeOf(count);
    char block[1024];
    for (std::size_t done = 0; done < length;) {
        const std::size_t part = std::min(length - done, sizeof block);
        std::transform(text + done, text + done + part, block, narrow);
        write(block, part);
        done += part;
    }
    return static_cast<int>(length);
}

void RnOutBuffer::endLine() { write("\n", 1); }
void RnOutBuffer::writeSeparator() { write(" ", 1); }

long RnOutBuffer::seek(long offset, int whence) {
    const bool stays = whence == 1 ? offset == 0 : whence == 0 && offset == _written;
    return stays ? _written : -1;
}

int RnOutBuffer::readBytes(void*, int) { return 0; }
void RnOutBuffer::skipSeparator(int) {}
void RnOutBuffer::unget(wchar_t) {}

int RnOutBuffer::get(wchar_t& c) {
    c = endOfInput;
    return 0;
}

}  // namespace Ov
