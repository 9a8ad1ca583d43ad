#include "host/componentManager/devices.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <fstream>
#include <random>
#include <sstream>

#include "host/componentManager/streamEx.h"
#include "testDevices.h"

namespace Ov {
namespace {

std::string manyLines() {
    std::mt19937 random(1);
    std::string text(40000, ' ');
    for (char& c : text) c = random() % 9 == 0 ? '\n' : static_cast<char>(random() % 256);
    return text;
}

/// A source that fails after `good` bytes.
class FailingSource : public std::streambuf {
public:
    explicit FailingSource(int good) : _good(good) {}

protected:
    int_type underflow() override {
        if (_good-- <= 0) throw std::runtime_error("disk on fire");
        setg(&_byte, &_byte, &_byte + 1);
        return 'x';
    }

private:
    int _good;
    char _byte = 'x';
};

class RefusingSink : public std::streambuf {};

/// Random steps on a device and on a plain string agree, its end and the borders of its blocks included.
void expectBehavesAsText(RnBufferedIO& device, std::string text) {
    std::mt19937 random(2);
    std::size_t at = 0;
    for (int step = 0; step < 8000; ++step) {
        SCOPED_TRACE(step);
        wchar_t c = 0;
        switch (random() % 8) {
            case 0: {
                const auto to = random() % 3 ? random() % (text.size() + 50) : text.size() - random() % 3;
                const bool inside = to <= text.size();
                const bool relative = random() % 2;
                const long offset = static_cast<long>(to) - (relative ? static_cast<long>(at) : 0);
                ASSERT_EQ(device.seek(offset, relative), inside ? static_cast<long>(to) : -1);
                if (inside) at = to;
                break;
            }
            case 1: {
                char bytes[50];
                const auto count = std::min<std::size_t>(random() % 50, text.size() - at);
                ASSERT_EQ(device.readBytes(bytes, static_cast<int>(count)), static_cast<int>(count));
                ASSERT_EQ(std::string(bytes, count), text.substr(at, count));
                at += count;
                break;
            }
            case 2:
                device.skipSeparator(2);
                at = std::min(at + 2, text.size());
                break;
            case 3:
                ASSERT_EQ(device.lineFeeds(),
                          std::count(text.begin(), text.begin() + static_cast<long>(at), '\n'));
                break;
            case 4:
                device.unget(RnBufferedIO::endOfInput);
                break;
            case 5:
                c = static_cast<wchar_t>(random() % 4 ? random() % 256 : '\n');
                device.unget(c);
                if (at == 0) {
                    text.insert(text.begin(), static_cast<char>(c));
                } else {
                    text[--at] = static_cast<char>(c);
                }
                break;
            case 6:
                if (at == text.size()) break;
                ASSERT_EQ(device.getChar(), static_cast<unsigned char>(text[at++]));
                break;
            default:
                const bool ends = at == text.size();
                ASSERT_EQ(device.get(c), ends ? 0 : 1);
                ASSERT_EQ(c, ends ? RnBufferedIO::endOfInput : static_cast<unsigned char>(text[at]));
                if (!ends) ++at;
        }
        ASSERT_EQ(device.seek(0, 1), static_cast<long>(at));
    }
}

TEST(Devices, ReadAsTheTextTheyHold) {
    const std::string text = manyLines();
    expectBehavesAsText(*rnCreate<RnMemoryBuffer>(text), text);
    expectBehavesAsText(*rnCreate<DripDevice>(text), text);
    std::istringstream source(text);
    expectBehavesAsText(*rnCreate<RnInBuffer>(&source), text);
    expectBehavesAsText(*rnCreate<RnMemoryBuffer>("a\nb"), "a\nb");
}

TEST(Devices, SeekOutsideChangesNothing) {
    const auto device = rnCreate<RnMemoryBuffer>("abc");
    EXPECT_EQ(device->seek(1, 0), 1);
    const long extremes[] = {std::numeric_limits<long>::max(), std::numeric_limits<long>::min(), -2, 3};
    for (long offset : extremes) EXPECT_EQ(device->seek(offset, 1), -1);
    EXPECT_EQ(device->seek(0, 2), -1);
    EXPECT_EQ(device->getChar(), 'b');
    EXPECT_EQ(device->seek(3, 0), 3);
    for (int i = 0; i < 3; ++i) EXPECT_EQ(device->getChar(), -1);
}

TEST(Devices, MemoryIsOverwrittenAndGrows) {
    const auto device = rnCreate<RnMemoryBuffer>("one\ntwo");
    EXPECT_EQ(readRest(*device), "one\ntwo");
    EXPECT_EQ(device->lineFeeds(), 1);
    device->seek(2, 0);
    EXPECT_EQ(device->writeChars(L"\u00E9\u20AC\xFF", 3), 3);
    EXPECT_EQ(device->lineFeeds(), 0);
    EXPECT_EQ(device->writeBytes("\0\n!", 3), 3);
    device->endLine();
    device->writeSeparator();
    EXPECT_EQ(device->bytes(), std::string("on\xE9?\xFF\0\n!\n ", 10));
    EXPECT_EQ(device->lineFeeds(), 2);
    EXPECT_EQ(device->getChar(), -1);
}

TEST(Devices, OutputGoesToTheSinkAtOnce) {
    std::ostringstream sink;
    const auto device = rnCreate<RnOutBuffer>(&sink);
    const std::wstring text(3000, L'\u00E9');
    EXPECT_EQ(device->writeChars(text.c_str(), 3000), 3000);
    device->endLine();
    device->writeSeparator();
    EXPECT_EQ(device->writeBytes("\n\x80", 2), 2);
    EXPECT_EQ(sink.str(), std::string(3000, '\xE9') + "\n \n\x80");
    EXPECT_EQ(device->lineFeeds(), 2);
    EXPECT_EQ(device->seek(0, 1), 3004);
    EXPECT_EQ(device->seek(1, 0), -1);
    wchar_t c = 0;
    EXPECT_EQ(device->get(c), 0);
    EXPECT_EQ(c, RnBufferedIO::endOfInput);
}

TEST(Devices, FailingSourcesAndSinksRaise) {
    FailingSource failing(3);
    std::istream quiet(&failing);
    const auto device = rnCreate<RnInBuffer>(&quiet);
    EXPECT_THROW(device->getChar(), RnStreamEx::ExReadError);

    FailingSource alsoFailing(3);
    std::istream loud(&alsoFailing);
    loud.exceptions(std::ios::badbit);
    EXPECT_THROW(rnCreate<RnInBuffer>(&loud)->getChar(), std::runtime_error);

    std::ifstream missing("/nonexistent/file");
    EXPECT_THROW(rnCreate<RnInBuffer>(&missing)->getChar(), RnStreamEx::ExReadError);

    // The mere end of the input is no failure, even for a stream that raises it.
    std::istringstream strict("xy");
    strict.exceptions(std::ios::failbit | std::ios::badbit | std::ios::eofbit);
    EXPECT_EQ(readRest(*rnCreate<RnInBuffer>(&strict)), "xy");

    RefusingSink refusing;
    std::ostream sink(&refusing);
    const auto out = rnCreate<RnOutBuffer>(&sink);
    EXPECT_THROW(out->writeChars(L"a", 1), RnStreamEx::ExWriteError);
    std::istringstream source("abc");
    const auto in = rnCreate<RnInBuffer>(&source);
    EXPECT_THROW(in->endLine(), RnStreamEx::ExWriteError);
    in->unget(L'z');
    EXPECT_EQ(readRest(*in), "zabc");
}

}  // namespace
}  // namespace Ov
