#pragma once

#include <functional>
#include <memory>
#include <string>
#include <vector>

#include "components/support/devices.h"
#include "components/support/path.h"
#include "host/componentManager/builder.h"
#include "host/componentManager/stream.h"
#include "support/dripDevice.h"
#include "support/plainDevice.h"

// Made-up objects, builders and a device for the tests of the host, and how their tables are written.

namespace Ov {

/// The cells of a row of a table, "a|b|c".
inline std::vector<std::string> cells(const std::string& row) {
    std::vector<std::string> all(1);
    for (const char c : row) c == '|' ? all.emplace_back().clear() : all.back().push_back(c);
    return all;
}

inline int readChar(RnBufferedIO& device) { return RnCharInput(device).getChar(); }

inline std::string readRest(RnBufferedIO& device) {
    std::string rest;
    for (int c = readChar(device); c >= 0; c = readChar(device)) rest += static_cast<char>(c);
    return rest;
}

using Facts = std::vector<std::wstring>;

/// What the builders create. It cannot be saved.
class Thing : public RnCastable {
public:
    static constexpr RnUid iid{1, 2, 3, 4};
    explicit Thing(Facts all = {}) : facts(std::move(all)) {}
    const Facts facts;  // the builder; imported, name, folder and content, too
};
using ThingObject = RnCastHeap<RnCastImpl<Thing, Thing>>;

class ThingDescription : public RnComponentBuilder {
public:
    using Creator = RnRef<RnCastable>();
    ThingDescription() = default;
    ThingDescription(const RnUid& id, const wchar_t* family, const wchar_t* called, Creator* creates = nullptr)
        : classId(id), category(family), name(called), creator(creates) {}
    const RnUid& getClassId() const override { return classId; }
    const wchar_t* getCategory() const override { return category; }
    const wchar_t* getName() const override { return name; }
    int getVersion() const override { return 1; }
    const wchar_t* getDescription() const override { return L""; }
    const wchar_t* getLegalNotice() const override { return L""; }
    const wchar_t* getVendor() const override { return L""; }
    bool isCreatable() const override { return true; }
    RnRef<RnCastable> create() override {
        return creator ? creator() : RnRef<RnCastable>(rnCreate<ThingObject>(Facts{name}));
    }

protected:
    RnUid classId;
    const wchar_t *category = L"Thing", *name = L"";
    Creator* creator = nullptr;  // of things, without one
};
using ThingBuilder = RnCastImpl<ThingDescription, RnComponentBuilder, RnBuilderDescription>;

/// Imports inputs that start with `start`.
class ThingImportBuilder
    : public RnCastImpl2<ThingDescription, RnImportBuilder, RnComponentBuilder, RnBuilderDescription> {
public:
    using RnImportBuilder::canImport;
    using RnImportBuilder::import;

    ThingImportBuilder(const RnUid& id, const wchar_t* called, const char* startsWith,
                       std::vector<const wchar_t*> ends)
        : start(startsWith), extensions(std::move(ends)) {
        classId = id;
        name = called;
    }
    RnEnum::Action enumerateExtensions(RnEnumerator<const wchar_t*>& visitor) override {
        for (const wchar_t* extension : extensions) visitor.visit(extension);
        return visitor.finish();
    }
    bool canImport(RnBufferedIO* io) override {
        std::string bytes(start.size(), '\0');
        const long position = io->seek(0, 1);
        io->readBytes(bytes.data(), static_cast<int>(bytes.size()));
        io->seek(position, 0);
        return bytes == start;
    }
    RnRef<RnCastable> import(RnPtr<RnBufferedIO> io, const wchar_t* called, const wchar_t* basePath) override {
        return rnCreate<ThingObject>(Facts{name, called, basePath, fromUtf8(readRest(*io))});
    }

    const std::string start;
    const std::vector<const wchar_t*> extensions;
};

class ThingRegistry : public RnCastImpl<RnComponentRegistry, RnComponentRegistry> {
public:
    explicit ThingRegistry(std::vector<RnComponentBuilder*> all) : builders(std::move(all)) {}
    RnRef<RnComponentBuilder> getBuilder(const RnUid& classId) override {
        for (RnComponentBuilder* builder : builders) {
            if (builder->getClassId() == classId) return builder->getBuilder();
        }
        return {};
    }
    int getVersion() const override { return 1; }
    const wchar_t* getLegalNotice() const override { return L""; }
    const wchar_t* getVendor() const override { return L""; }
    std::uint32_t getBuilderCount() const override { return static_cast<std::uint32_t>(builders.size()); }
    RnEnum::Action enumerateBuilders(RnEnumerator<RnPtr<RnComponentBuilder>>& visitor) override {
        for (RnComponentBuilder* builder : builders) visitor.visit(builder);
        return visitor.finish();
    }

    const std::vector<RnComponentBuilder*> builders;
};

class NoteData : public RnCastable {
public:
    static constexpr RnUid iid{0x11, 2, 3, 4}, classId{0x21, 2, 3, 4};
    static long alive() { return life.use_count() - 1; }
    /// What the notes whose load is finished call, with their texts.
    static inline std::function<void(const std::wstring&)> whenFinished;

    std::wstring text, loadName;
    int number = 0;
    RnRef<RnCastable> content;
    static inline const auto life = std::make_shared<int>();
    const std::shared_ptr<int> held = life;
};

class Note : public RnDataObject<Note, class NotePersistant, NoteData, NoteData> {};

/// Saves formatted text around another object; the line feed at its end is left unread. A text that begins with
/// "false" is refused without an exception.
class NotePersistant : public RnTempObject<Note> {
public:
    using RnTempObject::RnTempObject;
    void save(RnStream& stream) override {
        stream.formattedWrite(L"%s\n", data().text.c_str());
        stream << data().content.get();
        stream.formattedWrite(L" %d\n", data().number);
    }
    bool load(RnStream& stream, int, const wchar_t* name, const wchar_t* basePath) override {
        wchar_t text[80] = L"";
        stream.formattedRead(L"%79[^\n]%*c", text);
        data().text = text;
        data().loadName = name ? name : L"";
        data().content = stream.readObject(nullptr, name, basePath);
        if (stream.formattedRead(L"%d", &data().number) == 1) return !data().text.starts_with(L"false");
        throw RnStreamEx::ExReadError(__FILE__, __LINE__, "note stream");
    }
    void loadFinished() override { NoteData::whenFinished(data().text); }
};

inline RnRef<Note> note(const wchar_t* text, int number = 0, RnRef<RnCastable> content = {}) {
    auto result = rnCreate<Note>();
    result->text = text;
    result->number = number;
    result->content = std::move(content);
    return result;
}

}  // namespace Ov
