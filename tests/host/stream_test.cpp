#include "host/componentManager/stream.h"

#include <gmock/gmock.h>

#include <cmath>
#include <limits>

#include "host/componentManager/componentManager.h"
#include "testObjects.h"

namespace Ov {
namespace {

using testing::ElementsAre;
using Form = RnStream::Form;

constexpr Form forms[] = {Form::text, Form::binary};

template <class T>
bool same(const T& a, const T& b) {
    if constexpr (std::is_floating_point_v<T>) {
        if (std::isnan(a)) return std::isnan(b);
        return a == b && std::signbit(a) == std::signbit(b);
    } else {
        return a == b;
    }
}

/// Writes a run of values and a single one, and expects them back.
template <class T>
void expectRoundTrip(const std::vector<T>& values) {
    for (Form form : forms) {
        const auto device = rnCreate<RnMemoryBuffer>();
        RnStream out(device.get(), form);
        out.write(values[0], static_cast<int>(values.size()));
        out << values.back();
        device->seek(0, 0);
        RnStream in(device.get(), form);
        auto back = std::make_unique<T[]>(values.size());
        EXPECT_EQ(in.read(back[0], static_cast<int>(values.size())), static_cast<int>(values.size()));
        for (std::size_t i = 0; i < values.size(); ++i) EXPECT_TRUE(same(back[i], values[i])) << device->bytes();
        T last{};
        in >> last;
        EXPECT_TRUE(same(last, values.back())) << device->bytes();
        EXPECT_THROW(in >> last, RnStreamEx::ExReadError);
        EXPECT_EQ(in.read(last, 0), 0);
    }
}

template <class T>
void expectLimitsRoundTrip() {
    using Limits = std::numeric_limits<T>;
    expectRoundTrip<T>({Limits::min(), 0, 1, 42, static_cast<T>(Limits::max() / 3), Limits::max()});
}

TEST(StreamValues, EveryTypeReadsBack) {
    expectLimitsRoundTrip<unsigned long long>();
    expectLimitsRoundTrip<long long>();
    expectLimitsRoundTrip<unsigned int>();
    expectLimitsRoundTrip<int>();
    expectLimitsRoundTrip<unsigned short>();
    expectLimitsRoundTrip<short>();
    expectLimitsRoundTrip<unsigned char>();
    expectLimitsRoundTrip<char>();
    expectRoundTrip<unsigned long>({0, 0xFFFFFFFF});
    expectRoundTrip<long>({std::numeric_limits<std::int32_t>::min(), std::numeric_limits<std::int32_t>::max()});
    expectRoundTrip<wchar_t>({0, L' ', L'\u20AC', 0xFFFF});
    const bool flags[] = {true, false, true};
    for (Form form : forms) {
        const auto device = rnCreate<RnMemoryBuffer>();
        RnStream(device.get(), form).write(flags[0], 3);
        device->seek(0, 0);
        bool back[3] = {false, true, false};
        RnStream(device.get(), form).read(back[0], 3);
        EXPECT_THAT(back, ElementsAre(true, false, true));
    }
}

TEST(StreamValues, RealsReadBackExactly) {
    const auto check = [](auto zero) {
        using T = decltype(zero);
        using Limits = std::numeric_limits<T>;
        expectRoundTrip<T>({T(0), -T(0), T(0.1), T(1) / 3, T(1e10), Limits::max(), Limits::lowest(), Limits::min(),
                            Limits::denorm_min(), Limits::infinity(), -Limits::infinity(), Limits::quiet_NaN()});
    };
    check(0.F);
    check(0.);
}

TEST(StreamValues, StringsKeepAnyContent) {
    std::wstring everything;
    for (int c = 0; c < 0x3000; ++c) everything += static_cast<wchar_t>(c);
    everything += {0xDC80, 0xDC81, 0xD800};  // alone, not in pairs
    everything += L"\U0001F4A1\U0010FFFF";
    expectRoundTrip<std::wstring>({L"", L" two words ", L"\"quoted\" \\u0041 \\", L"line\r\nfeed\t", everything});
}

TEST(StreamValues, BinaryFormIsLittleEndianInFixedWidths) {
    const auto device = rnCreate<RnMemoryBuffer>();
    RnStream out(device.get(), Form::binary);
    out << 0x0102030405060708ULL << -2LL << std::wstring(L"a\u20AC\U0001F4A1") << 1.0 << 1.0F << true << 3UL << -3L
        << 4U << -4 << static_cast<unsigned short>(5) << static_cast<short>(-5) << static_cast<unsigned char>(6)
        << L'\u20AC' << '\xFF';
    const char expected[] =
        "\x08\x07\x06\x05\x04\x03\x02\x01"
        "\xFE\xFF\xFF\xFF\xFF\xFF\xFF\xFF"
        "\x04\0\0\0"
        "a\0"
        "\xAC\x20"
        "\x3D\xD8"
        "\xA1\xDC"
        "\0\0\0\0\0\0\xF0\x3F"
        "\0\0\x80\x3F"
        "\x01"
        "\x03\0\0\0"
        "\xFD\xFF\xFF\xFF"
        "\x04\0\0\0"
        "\xFC\xFF\xFF\xFF"
        "\x05\0"
        "\xFB\xFF"
        "\x06"
        "\xAC\x20"
        "\xFF";
    EXPECT_EQ(device->bytes(), std::string(expected, sizeof expected - 1));
    EXPECT_EQ(out.column, 0);
    EXPECT_FALSE(out.pendingSeparator);
}

TEST(StreamValues, TextLinesBreakAfterColumn70) {
    const auto device = rnCreate<RnMemoryBuffer>();
    RnStream stream(device.get(), Form::text);
    for (int i = 1; i <= 100; ++i) stream << 1000 * i;
    std::size_t longest = 0, start = 0;
    for (std::size_t end; (end = device->bytes().find('\n', start)) != std::string::npos; start = end + 1) {
        longest = std::max(longest, end - start);
        EXPECT_GT(end - start, 70U);
    }
    EXPECT_GT(start, 0U);
    EXPECT_LE(longest, 78U);
    EXPECT_EQ(stream.column, static_cast<int>(device->bytes().size() - start));
    EXPECT_TRUE(stream.pendingSeparator);
    device->seek(0, 0);
    for (int i = 1, value = 0; i <= 100; ++i) {
        stream >> value;
        EXPECT_EQ(value, 1000 * i);
    }
}

TEST(StreamValues, AnItemLeavesExactlyOneSeparatorDue) {
    const auto device = rnCreate<RnMemoryBuffer>("  12\n raw text");
    RnStream stream(device.get(), Form::text);
    int value = 0;
    stream >> value;
    EXPECT_TRUE(stream.pendingSeparator);
    EXPECT_EQ(stream.computeLineNb(), 1);
    EXPECT_EQ(stream.getChar(), ' ');
    EXPECT_FALSE(stream.pendingSeparator);
    EXPECT_EQ(stream.computeLineNb(), 2);
    stream.ungetChar(' ');
    stream.ungetChar(-1);
    EXPECT_EQ(readRest(stream.device()), " raw text");
    EXPECT_EQ(stream.getChar(), -1);
}

template <class T>
void expectRefused(Form form, std::string_view input) {
    SCOPED_TRACE(input);
    const auto device = rnCreate<RnMemoryBuffer>(input);
    T value{};
    EXPECT_THROW(RnStream(device.get(), form) >> value, RnStreamEx::ExReadError);
    EXPECT_EQ(value, T{});
}

TEST(StreamValues, WhatIsMissingOrCannotBeHeldRaises) {
    for (const char* text : {"", " \n", "x", "12x", "1.5", "-", "2147483648", "0x10"})
        expectRefused<int>(Form::text, text);
    for (const char* text : {"1e39", "1,5", "1e", "."}) expectRefused<float>(Form::text, text);
    for (const char* text : {"2", "true"}) expectRefused<bool>(Form::text, text);
    for (const char* text : {"256", "-1"}) expectRefused<unsigned char>(Form::text, text);
    for (const char* text : {"word", "\"open", "\"\\", "\"\\n\"", "\"\\u12", "\"\\u12g4\""}) {
        expectRefused<std::wstring>(Form::text, text);
    }
    expectRefused<int>(Form::text, std::string(1 << 20, '1'));
    expectRefused<int>(Form::binary, "123");
    expectRefused<double>(Form::binary, "1234567");
    expectRefused<bool>(Form::binary, "\x02");
    // A length that nothing stands behind costs nothing.
    expectRefused<std::wstring>(Form::binary,
                                "\xFF\xFF\xFF\xFF"
                                "abcd");

    RnStream out(rnCreate<RnMemoryBuffer>().get(), Form::binary);
    if constexpr (sizeof(long) > 4) {
        EXPECT_THROW(out << (1L << 31), RnStreamEx::ExWriteError);
        EXPECT_THROW(out << (1UL << 32), RnStreamEx::ExWriteError);
    }
    if constexpr (sizeof(wchar_t) > 2) {
        EXPECT_THROW(out << static_cast<wchar_t>(0x10000), RnStreamEx::ExWriteError);
        EXPECT_THROW(out << std::wstring(1, static_cast<wchar_t>(0x110000)), RnStreamEx::ExWriteError);
    }
}

TEST(StreamEx, SaysWhereAndIsCaughtAsEither) {
    try {
        throw RnStreamEx::ExReadError("components/photo/ies/ies", 12, "IES stream");
    } catch (const std::runtime_error& error) {
        EXPECT_STREQ(error.what(), "IES stream");
        const auto& base = dynamic_cast<const ExBase&>(error);
        EXPECT_STREQ(base.getReason(), "IES stream");
        EXPECT_THAT(base.getDetailedReason(), testing::HasSubstr("components/photo/ies/ies, line 12"));
    }
}

// Whole objects.

class StreamObjects : public testing::TestWithParam<Form> {
protected:
    StreamObjects() { manager()->addRegistry(_registry); }
    ~StreamObjects() override {
        manager()->removeRegistry(_registry);
        finishedLoads.clear();
    }

    static RnRef<RnComponentManager> manager() { return rnCast<RnComponentManager>(RnGetComponentManager()); }
    RnRef<Note> note(const wchar_t* text, int number) {
        auto object = rnCreate<Note>();
        object->text = text;
        object->number = number;
        return object;
    }
    RnRef<Box> box(float size, RnRef<RnCastable> content, const wchar_t* label) {
        auto object = rnCreate<Box>();
        object->size = size;
        object->content = std::move(content);
        object->label = label;
        return object;
    }
    template <class T>
    static RnRef<T> readAs(RnStream& stream) {
        const auto object = stream.readObject(&T::iid, L"name");
        return object ? rnCast<T>(object.get()) : RnRef<T>();
    }
    void rewind() {
        device->seek(0, 0);
        stream.pendingSeparator = false;
    }

    ObjectBuilder<Note> _notes;
    ObjectBuilder<Box> _boxes;
    ThingRegistry _registry{{&_notes, &_boxes}};
    RnRef<RnMemoryBuffer> device = rnCreate<RnMemoryBuffer>();
    RnStream stream{device.get(), GetParam()};
};

TEST_P(StreamObjects, FollowOneAnotherAndTypedValues) {
    stream << 17 << note(L"  first line", 1).get() << note(L"second", 2).get() << static_cast<RnCastable*>(nullptr)
           << box(0.5F, box(1.5F, note(L"inner", 3), L"b"), L"a").get() << box(2, {}, L"c").get() << 18;
    rewind();
    int before = 0, after = 0;
    stream >> before;
    EXPECT_EQ(before, 17);
    EXPECT_EQ(readAs<NoteData>(stream)->text, L"  first line");
    EXPECT_EQ(readAs<NoteData>(stream)->number, 2);
    EXPECT_FALSE(readAs<NoteData>(stream));
    const auto outer = readAs<BoxData>(stream);
    EXPECT_EQ(outer->label, L"a");
    EXPECT_EQ(outer->loadName, L"name");
    const auto inner = rnCast<BoxData>(outer->content.get());
    EXPECT_EQ(inner->size, 1.5F);
    EXPECT_EQ(rnCast<NoteData>(inner->content.get())->text, L"inner");
    const auto last = readAs<BoxData>(stream);
    EXPECT_FALSE(last->content);
    EXPECT_EQ(last->size, 2);
    stream >> after;
    EXPECT_EQ(after, 18);
    EXPECT_THAT(finishedLoads, ElementsAre(L"  first line", L"second", L"inner", L"box b", L"box a", L"box c"));
}

TEST_P(StreamObjects, HearOfTheEndOfTheirLoadWhenTheListEnds) {
    stream << note(L"one", 1).get() << note(L"two", 2).get();
    rewind();
    {
        RnPostLoadList all, own;
        RnStream outer(device.get(), GetParam(), &all), inner(device.get(), GetParam(), &own);
        readAs<NoteData>(inner);
        outer.pendingSeparator = inner.pendingSeparator;
        readAs<NoteData>(outer);
        outer.transfer(own);
        EXPECT_TRUE(own.empty());
        EXPECT_THAT(finishedLoads, ElementsAre());
    }
    EXPECT_THAT(finishedLoads, ElementsAre(L"two", L"one"));
}

TEST_P(StreamObjects, ThatRefuseToLoadAreNull) {
    const int alive = NoteData::alive;
    stream << note(L"false start", 1).get() << note(L"next", 2).get();
    rewind();
    EXPECT_FALSE(stream.readObject(nullptr));
    EXPECT_EQ(readAs<NoteData>(stream)->text, L"next");
    EXPECT_THAT(finishedLoads, ElementsAre(L"next"));
    EXPECT_EQ(NoteData::alive, alive);
}

TEST_P(StreamObjects, RaiseWhenTheyCannotBeReadOrWritten) {
    const int alive = NoteData::alive;
    EXPECT_THROW(stream << rnCreate<ThingObject>().get(), ExBadCast);
    EXPECT_TRUE(device->bytes().empty());

    stream << note(L"text", 1).get();
    rewind();
    EXPECT_THROW(readAs<BoxData>(stream), ExBadCast);
    EXPECT_TRUE(finishedLoads.empty());

    // Cut off anywhere, an object never comes back as if it were whole.
    const std::string whole = device->bytes();
    const auto needed = GetParam() == Form::text ? whole.find(" 1\n") + 2 : whole.size();
    for (std::size_t length = 0; length < needed; ++length) {
        RnStream cut(rnCreate<RnMemoryBuffer>(std::string_view(whole).substr(0, length)).get(), GetParam());
        EXPECT_THROW(cut.readObject(nullptr), RnStreamEx::ExReadError) << length;
    }

    const auto other = rnCreate<RnMemoryBuffer>();
    RnStream newer(other.get(), GetParam());
    const RnUid& id = Note::classId;
    newer << id.w0 << id.w1 << id.w2 << id.w3 << 2;
    other->seek(0, 0);
    EXPECT_THROW(newer.readObject(nullptr), RnStreamEx::ExReadError);

    manager()->removeRegistry(_registry);
    rewind();
    EXPECT_THROW(stream.readObject(nullptr), RnStreamEx::ExReadError);
    EXPECT_EQ(NoteData::alive, alive);
}

/// A save that fails inside an object leaves the stream on its own device.
TEST_P(StreamObjects, ThatFailToSaveLeaveTheStreamUsable) {
    EXPECT_THROW(stream << box(1, rnCreate<ThingObject>(), L"").get(), ExBadCast);
    EXPECT_EQ(&stream.device(), device.get());
    const long start = device->seek(0, 1);
    stream << 5;
    device->seek(start, 0);
    int value = 0;
    stream >> value;
    EXPECT_EQ(value, 5);
}

INSTANTIATE_TEST_SUITE_P(Forms, StreamObjects, testing::ValuesIn(forms),
                         [](const auto& form) { return form.param == Form::text ? "text" : "binary"; });

TEST(StreamState, ItemsAndLinesKeepColumnAndSeparator) {
    const auto device = rnCreate<RnMemoryBuffer>();
    RnStream stream(device.get(), Form::text);
    stream.writeItem(L" 1.00", 5);
    EXPECT_FALSE(stream.pendingSeparator);
    EXPECT_EQ(stream.column, 5);
    stream.pendingSeparator = true;
    stream.column = 70;
    stream.writeItem(L"a", 1);
    EXPECT_EQ(stream.column, 72);
    stream.pendingSeparator = true;
    stream.writeItem(L"bc", 2);
    EXPECT_EQ(stream.column, 2);
    stream.pendingSeparator = true;
    stream.endLine();
    EXPECT_EQ(stream.column, 0);
    EXPECT_FALSE(stream.pendingSeparator);
    EXPECT_EQ(device->bytes(), " 1.00 a\nbc\n");
    EXPECT_THROW(RnStream(RnPtr<RnBufferedIO>(), Form::text), ExBadCast);
}

}  // namespace
}  // namespace Ov
