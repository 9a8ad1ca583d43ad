#include "host/componentManager/stream.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <compare>
#include <limits>
#include <random>
#include <sstream>

#include "components/support/streamText.h"
#include "host/componentManager/componentManager.h"
#include "testObjects.h"

using namespace Ov;
using namespace std::string_literals;
using testing::ElementsAre;
using Form = RnStream::Form;

/// Random steps on a device and on a plain string agree, its end and the borders of its blocks included.
void expectBehavesAsText(RnBufferedIO& device, std::string text) {
    std::mt19937 random(2);
    for (std::size_t step = 0, at = 0; step < 8000 && !testing::Test::HasFailure(); ++step) {
        wchar_t c = static_cast<wchar_t>(random() % 4 ? random() % 256 : '\n');
        const auto action = random() % 5;
        if (action == 0) {
            const auto to = random() % 3 ? random() % (text.size() + 50) : text.size() - random() % 3;
            const long offset = static_cast<long>(to) - static_cast<long>(c % 2 ? at : 0);
            EXPECT_EQ(device.seek(offset, c % 2), to <= text.size() ? static_cast<long>(to) : -1);
            if (to <= text.size()) at = to;
        } else if (action == 1) {
            std::string bytes(std::min<std::size_t>(random() % 50, text.size() - at), '?');
            EXPECT_EQ(device.readBytes(bytes.data(), static_cast<int>(bytes.size())), bytes.size());
            EXPECT_EQ(bytes, text.substr(at, bytes.size()));
            at += bytes.size();
        } else if (action == 2) {
            device.skipSeparator(2);
            at = std::min(at + 2, text.size());
        } else if (action == 3) {
            device.unget(RnBufferedIO::endOfInput);
            device.unget(c);
            text.replace(at - (at > 0), at > 0, 1, static_cast<char>(c));
            at -= at > 0;
        } else {
            EXPECT_EQ(device.get(c), at < text.size());
            EXPECT_EQ(c, at < text.size() ? static_cast<unsigned char>(text[at++]) : RnBufferedIO::endOfInput);
        }
        EXPECT_EQ(device.seek(0, 1), static_cast<long>(at)) << "step " << step;
        if (random() % 4) continue;
        EXPECT_EQ(RnStream(&device, Form::text).computeLineNb(),
                  1 + std::count(text.begin(), text.begin() + static_cast<long>(at), '\n'));
        EXPECT_EQ(device.seek(0, 1), static_cast<long>(at));
    }
}

TEST(Devices, ReadAsTheTextTheyHold) {
    std::mt19937 random(1);
    std::string text(40000, ' ');
    for (char& c : text) c = random() % 9 == 0 ? '\n' : static_cast<char>(random() % 256);
    std::istringstream source(text);
    const auto tiny = rnCreate<RnMemoryBuffer>("a\nb");
    expectBehavesAsText(*tiny, "a\nb");
    expectBehavesAsText(*rnCreate<RnMemoryBuffer>(text), text);
    expectBehavesAsText(*rnCreate<DripDevice>(text), text);
    expectBehavesAsText(*rnCreate<RnInBuffer>(&source), text);
    for (const long offset : {std::numeric_limits<long>::max(), std::numeric_limits<long>::min()})
        EXPECT_EQ(tiny->seek(offset, 1), -1);
}

TEST(Devices, MemoryIsOverwrittenAndGrowsAndASinkGetsAllAtOnce) {
    std::ostringstream sink;
    const auto memory = rnCreate<RnMemoryBuffer>("one\ntwo");
    const auto out = rnCreate<RnOutBuffer>(&sink);
    EXPECT_EQ(readRest(*memory), "one\ntwo");
    memory->seek(0, 0);
    const std::wstring text = L"\u20AC" + std::wstring(3000, L'\u00E9');
    for (const RnRef<RnBufferedIO>& device : {RnRef<RnBufferedIO>(memory), RnRef<RnBufferedIO>(out)}) {
        EXPECT_EQ(device->writeChars(text.c_str(), 3001), 3001);
        EXPECT_EQ(device->writeChars(L"\0\n\x80", 3), 3);
        device->endLine();
        device->writeSeparator();
        EXPECT_EQ(device->seek(0, 1), 3006);
        EXPECT_EQ(device->seek(3007, 0) + readChar(*device), -2);
    }
    EXPECT_EQ(sink.str(), "?" + std::string(3000, '\xE9') + std::string("\0\n\x80\n ", 5));
    EXPECT_EQ(memory->bytes(), sink.str());
}

/// Fails at once, whether read or written.
class BadBuffer : public std::streambuf {
    int_type underflow() override { throw std::runtime_error("disk on fire"); }
};

TEST(Devices, FailingSourcesAndSinksRaise) {
    BadBuffer bad;
    std::istream quiet(&bad), loud(&bad), missing(nullptr);
    std::ostream sink(&bad);
    loud.exceptions(std::ios::badbit);
    EXPECT_THROW(readChar(*rnCreate<RnInBuffer>(&quiet)), RnStreamEx::ExReadError);
    EXPECT_THROW(readChar(*rnCreate<RnInBuffer>(&missing)), RnStreamEx::ExReadError);
    EXPECT_THROW(readChar(*rnCreate<RnInBuffer>(&loud)), std::runtime_error);
    EXPECT_THROW(rnCreate<RnOutBuffer>(&sink)->writeChars(L"a", 1), RnStreamEx::ExWriteError);
    // The mere end of the input is no failure, even for a stream that raises it.
    std::istringstream strict("xy");
    strict.exceptions(std::ios::failbit | std::ios::badbit | std::ios::eofbit);
    const auto in = rnCreate<RnInBuffer>(&strict);
    EXPECT_EQ(readRest(*in), "xy");
    EXPECT_THROW(in->endLine(), RnStreamEx::ExWriteError);
}

/// Writes a run of values and a single one, and expects them back, the sign of a zero and NaN too, and no more.
template <class T>
void expectRoundTrip(std::initializer_list<T> values) {
    const int count = static_cast<int>(values.size());
    for (Form form : {Form::text, Form::binary}) {
        const auto device = rnCreate<RnMemoryBuffer>();
        RnStream out(device.get(), form), in(device.get(), form);
        out.write(*values.begin(), count);
        out << *values.begin();
        device->seek(0, 0);
        auto back = std::make_unique<T[]>(values.size() + 1);
        EXPECT_EQ(in.read(back[0], count), count);
        in >> back[values.size()];
        for (std::size_t i = 0; i <= values.size(); ++i)
            EXPECT_TRUE(std::is_eq(std::strong_order(back[i], values.begin()[i % values.size()]))) << i;
        EXPECT_THROW(in >> back[0], RnStreamEx::ExReadError);
    }
}

/// The limits of a type; of integers, some of these are 0.
template <class... T>
void expectLimitsRoundTrip() {
    (expectRoundTrip<T>({std::numeric_limits<T>::lowest(), T(0.1), static_cast<T>(-T(0)),
                         std::numeric_limits<T>::min(), std::numeric_limits<T>::denorm_min(),
                         std::numeric_limits<T>::infinity(), std::numeric_limits<T>::quiet_NaN(),
                         static_cast<T>(std::numeric_limits<T>::max() / 3), std::numeric_limits<T>::max()}),
     ...);
}

TEST(StreamValues, EveryTypeReadsBack) {
    expectLimitsRoundTrip<unsigned long long, long long, unsigned int, int, unsigned short, short, unsigned char,
                          char, bool, float, double>();
    // Of these the streams hold as much as every platform has.
    expectRoundTrip<unsigned long>({0, 0xFFFFFFFF});
    expectRoundTrip<long>({std::numeric_limits<std::int32_t>::min(), std::numeric_limits<std::int32_t>::max()});
    expectRoundTrip<wchar_t>({0, L' ', L'\u20AC', 0xFFFF});
    std::wstring everything;
    for (wchar_t c = 0; c < 0x3000; ++c) everything += c;
    everything += L"\xDC80\xDC81\xD800 \U0001F4A1\U0010FFFF";  // surrogates alone, and pairs
    expectRoundTrip<std::wstring>({L"", L" two words ", L"\"quoted\" \\u0041 \\", L"line\r\nfeed\t", everything});
}

TEST(StreamValues, BinaryFormIsLittleEndianInFixedWidths) {
    const auto device = rnCreate<RnMemoryBuffer>();
    RnStream(device.get(), Form::binary) << 0x0102030405060708ULL << std::wstring(L"a\u20AC\U0001F4A1") << 1.0F
                                         << true << -3L << 3UL << static_cast<short>(-5) << L'\u20AC';
    EXPECT_EQ(device->bytes(),
              "\x8\x7\x6\x5\x4\x3\x2\x1\x4\0\0\0a\0\xAC \x3D\xD8\xA1\xDC\0\0\x80?\x1"
              "\xFD\xFF\xFF\xFF\x3\0\0\0\xFB\xFF\xAC "s);
}

template <class T>
void expectRefused(Form form, std::initializer_list<std::string> inputs) {
    for (const std::string& input : inputs) {
        T value{};
        EXPECT_THROW(RnStream(rnCreate<RnMemoryBuffer>(input).get(), form) >> value, RnStreamEx::ExReadError);
        EXPECT_EQ(value, T{}) << input;
    }
}

TEST(StreamValues, WhatIsMissingOrCannotBeHeldRaises) {
    expectRefused<int>(Form::text, {" \n", "x", "12x", "1.5", "-", "2147483648", std::string(1 << 20, '1')});
    expectRefused<float>(Form::text, {"1e39", "1,5", "1e", "."});
    expectRefused<bool>(Form::text, {"2", "true"});
    expectRefused<unsigned char>(Form::text, {"256", "-1"});
    expectRefused<std::wstring>(Form::text, {"word", "\"open", "\"\\", "\"\\n\"", "\"\\u12", "\"\\u12g4\""});
    expectRefused<int>(Form::binary, {"123"});
    expectRefused<bool>(Form::binary, {"\x02"});
    expectRefused<std::wstring>(Form::binary, {"\xFF\xFF\xFF\xFF____"});  // a length that nothing stands behind
    RnStream out(rnCreate<RnMemoryBuffer>().get(), Form::binary);
    if (sizeof(long) > 4) {
        EXPECT_THROW(out << (1L << 31), RnStreamEx::ExWriteError);
    }
    if (sizeof(wchar_t) > 2) {
        EXPECT_THROW(out << std::wstring(1, static_cast<wchar_t>(0x110000)), RnStreamEx::ExWriteError);
    }
}

TEST(StreamValues, ItemsAndLinesKeepColumnAndSeparator) {
    const auto device = rnCreate<RnMemoryBuffer>();
    RnStream stream(device.get(), Form::text);
    const auto state = [&] { return std::tuple{stream.column, stream.pendingSeparator, stream.computeLineNb()}; };
    writeItem(stream, L" 1.00", 5);
    EXPECT_EQ(state(), std::tuple(5, false, 1));
    stream << 23 << 4;
    EXPECT_EQ(state(), std::tuple(9, true, 1));
    stream.column = 70;
    stream << 5;
    EXPECT_EQ(state(), std::tuple(72, true, 1));
    stream << 67;
    endLine(stream);
    EXPECT_EQ(state(), std::tuple(0, false, 3));
    // Read, an item leaves exactly one separator due.
    device->seek(0, 0);
    float values[3];
    stream.read(values[0], 3);
    EXPECT_EQ(state(), std::tuple(0, true, 1));
    RnStreamInput chars(stream);
    EXPECT_EQ(chars.getChar(), '6');
    EXPECT_EQ(state(), std::tuple(0, false, 2));
    chars.ungetChar('9');
    chars.ungetChar(-1);
    EXPECT_EQ(readRest(*device), "97\n");
    EXPECT_EQ(device->bytes(), " 1.0023 4 5\n97\n");
    EXPECT_THROW(RnStream(RnPtr<RnBufferedIO>(), Form::text), ExBadCast);
}

class StreamObjects : public testing::TestWithParam<Form> {
protected:
    StreamObjects() {
        NoteData::whenFinished = [this](const std::wstring& text) { finished.push_back(text); };
        manager->addRegistry(registry);
    }
    ~StreamObjects() override { manager->removeRegistry(registry); }

    static RnRef<NoteData> readNote(RnStream& from) {
        return rnQuery<NoteData>(from.readObject(&NoteData::iid, L"name").get());
    }

    RnRef<RnComponentManager> manager = rnCast<RnComponentManager>(RnGetComponentManager());
    ThingBuilder builder{NoteData::classId, L"Test", L"Note", [] { return rnCreateOrNull<Note>(); }};
    ThingRegistry registry{{&builder}};
    RnRef<RnMemoryBuffer> device = rnCreate<RnMemoryBuffer>();
    RnStream stream{device.get(), GetParam()};
    std::vector<std::wstring> finished;
};

TEST_P(StreamObjects, FollowOneAnotherAndHearOfTheEndOfTheirLoad) {
    stream << 17 << note(L"  one", 1).get() << static_cast<RnCastable*>(nullptr) << note(L"false start").get()
           << note(L"outer", 2, note(L"middle", 3, note(L"inner", 4))).get() << note(L"last", 5).get() << 18;
    device->seek(0, 0);
    RnPostLoadList own, all;
    RnStream in(device.get(), GetParam(), &own);
    int before = 0, after = 0;
    in >> before;
    EXPECT_EQ(readNote(in)->text, L"  one");
    EXPECT_FALSE(readNote(in) || readNote(in));  // null, and one that refuses to load
    const auto outer = readNote(in), middle = rnCast<NoteData>(outer->content.get());
    EXPECT_EQ((std::tuple{outer->number, middle->number, middle->loadName}), (std::tuple{2, 3, L"name"s}));
    EXPECT_THAT(finished, ElementsAre());
    // Without a list an object hears at once, and so do those of a list handed over.
    EXPECT_EQ(readNote(stream)->number, 5);
    RnStream(device.get(), GetParam(), &all).transfer(own);
    EXPECT_THAT(finished, ElementsAre(L"last"));
    stream.transfer(all);
    EXPECT_THAT(finished, ElementsAre(L"last", L"  one", L"inner", L"middle", L"outer"));
    stream >> after;
    EXPECT_EQ(before + after, 17 + 18);
}

TEST_P(StreamObjects, RaiseWhenTheyCannotBeReadOrWritten) {
    EXPECT_THROW(stream << rnCreate<ThingObject>().get(), ExBadCast);
    stream << note(L"text", 1).get();
    device->seek(0, 0);
    EXPECT_THROW(stream.readObject(&Thing::iid), ExBadCast);
    EXPECT_THAT(finished, ElementsAre());

    // Cut off anywhere, an object never comes back as if it were whole.
    const std::string whole = device->bytes();
    const auto needed = GetParam() == Form::text ? whole.size() - 1 : whole.size();
    for (std::size_t length = 0; length < needed; ++length) {
        RnStream cut(rnCreate<RnMemoryBuffer>(whole.substr(0, length)).get(), GetParam());
        EXPECT_THROW(readNote(cut), RnStreamEx::ExReadError) << length;
    }
    RnStream other(rnCreate<RnMemoryBuffer>().get(), GetParam());
    const RnUid& id = NoteData::classId;
    other << id.w0 << id.w1 << id.w2 << id.w3 << 2;  // a newer version
    other.device().seek(0, 0);
    EXPECT_THROW(readNote(other), RnStreamEx::ExReadError);
    EXPECT_THROW(other << note(L"", 1, rnCreate<ThingObject>()).get(), ExBadCast);
    manager->removeRegistry(registry);
    device->seek(0, 0);
    EXPECT_THROW(readNote(stream), RnStreamEx::ExReadError);
    EXPECT_EQ(NoteData::alive(), 0);
}

/// Nothing is loaded of an object that does not answer, and none goes deeper than the program's stack.
TEST_P(StreamObjects, AreLoadedAsFarAsTheyAreWantedAndStandInOneAnother) {
    constexpr int deepest = 256;
    const auto nested = [](int depth) {
        auto all = note(L"x");
        while (--depth > 0) all = note(L"x", 0, all);
        return all;
    };
    stream << nested(deepest).get();
    device->seek(0, 0);
    EXPECT_TRUE(readNote(stream));
    EXPECT_THROW(stream << nested(deepest + 1).get(), RnStreamEx::ExWriteError);

    const auto endless = rnCreate<RnMemoryBuffer>();
    RnStream levels(endless.get(), GetParam());
    const RnUid& id = NoteData::classId;
    for (int level = 0; level < 40000; ++level) {
        levels << id.w0 << id.w1 << id.w2 << id.w3 << 1;
        GetParam() == Form::text ? endLine(levels) : void(levels << 1000U);
        levels.formattedWrite(L"x\n");
    }
    for (int again = 0; again < 2; ++again) {
        endless->seek(0, 0);
        EXPECT_THROW(levels.readObject(nullptr), RnStreamEx::ExReadError);
    }
    endless->seek(0, 0);
    EXPECT_THROW(levels.readObject(&Thing::iid), ExBadCast);
    EXPECT_LT(endless->seek(0, 1), 100);
}

INSTANTIATE_TEST_SUITE_P(Forms, StreamObjects, testing::Values(Form::text, Form::binary));
