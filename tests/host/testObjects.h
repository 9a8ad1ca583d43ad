#pragma once

#include "host/componentManager/stream.h"
#include "testBuilders.h"
#include "testDevices.h"

// Objects that save themselves, for tests of streams and of the cast pattern.

namespace Ov {

/// What the tests of the post-load list see: the names of the objects whose load is finished, in order.
inline std::vector<std::wstring> finishedLoads;

class NotePersistant;

/// A text and a number, saved as formatted text that ends with a line feed which its loader leaves unread.
class NoteData : public RnCastable {
public:
    static constexpr RnUid iid{0x11, 2, 3, 4};
    static constexpr RnUid classId{0x21, 2, 3, 4};
    static inline int alive = 0;

    NoteData() { ++alive; }
    NoteData(const NoteData& other) : RnCastable(other), text(other.text), number(other.number) { ++alive; }
    ~NoteData() override { --alive; }

    std::wstring text = L"-";
    int number = 0;
};

class Note : public RnDataObject<Note, NotePersistant, NoteData, NoteData> {};

class NotePersistant : public RnTempObject<Note> {
public:
    using RnTempObject::RnTempObject;
    void save(RnStream& stream) override {
        stream.formattedWrite(L"%s", data().text.c_str());
        stream.endLine();
        stream.formattedWrite(L" %d", data().number);
        stream.endLine();
    }
    /// A text that begins with "false" is refused without an exception.
    bool load(RnStream& stream, int, const wchar_t*, const wchar_t*) override {
        wchar_t text[80];
        int number = 0;
        if (stream.formattedRead(L"%79[^\n]%d", text, &number) != 2) {
            throw RnStreamEx::ExReadError(__FILE__, __LINE__, "note stream");
        }
        data().text = text;
        data().number = number;
        return data().text.substr(0, 5) != L"false";
    }
    void loadFinished() override { finishedLoads.push_back(data().text); }
};

class BoxPersistant;

/// Typed values around an object of its own.
class BoxData : public RnCastable {
public:
    static constexpr RnUid iid{0x12, 2, 3, 4};
    static constexpr RnUid classId{0x22, 2, 3, 4};

    float size = 0;
    RnRef<RnCastable> content;
    std::wstring label, loadName;
};

class Box : public RnDataObject<Box, BoxPersistant, BoxData, BoxData> {};

class BoxPersistant : public RnTempObject<Box> {
public:
    using RnTempObject::RnTempObject;
    void save(RnStream& stream) override { stream << data().size << data().content.get() << data().label; }
    bool load(RnStream& stream, int, const wchar_t* name, const wchar_t* basePath) override {
        stream >> data().size;
        data().content = stream.readObject(nullptr, name, basePath);
        stream >> data().label;
        data().loadName = name ? name : L"";
        return true;
    }
    void loadFinished() override { finishedLoads.push_back(L"box " + data().label); }
};

template <class T>
class ObjectBuilder : public ThingBuilder {
public:
    ObjectBuilder() : ThingBuilder(T::classId, L"Test", L"Object") {}
    RnRef<RnCastable> create() override { return rnCreateOrNull<T>(); }
};

}  // namespace Ov
