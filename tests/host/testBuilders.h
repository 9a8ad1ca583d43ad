#pragma once

#include <string>
#include <vector>

#include "host/componentManager/builder.h"
#include "host/componentManager/castImpl.h"

// Builders of a made-up family, for tests of the register and of importers.

namespace Ov {

/// What they create: remembers how it was imported.
class Thing : public RnCastable {
public:
    static constexpr RnUid iid{1, 2, 3, 4};
    RnUid classId;
    std::wstring name, basePath;
    std::string firstBytes;
};
using ThingObject = RnCastHeap<RnCastImpl<Thing, Thing>>;

class ThingDescription : public RnComponentBuilder {
public:
    const RnUid& getClassId() const override { return classId; }
    const wchar_t* getCategory() const override { return category; }
    const wchar_t* getName() const override { return name; }
    int getVersion() const override { return 1; }
    const wchar_t* getDescription() const override { return L""; }
    const wchar_t* getLegalNotice() const override { return L""; }
    const wchar_t* getVendor() const override { return L""; }
    bool isCreatable() const override { return true; }
    RnRef<RnCastable> create() override {
        auto thing = rnCreate<ThingObject>();
        thing->classId = classId;
        return thing;
    }

    RnUid classId;
    const wchar_t* category = L"";
    const wchar_t* name = L"";
};

class ThingBuilder : public RnCastImpl<ThingDescription, RnComponentBuilder, RnBuilderDescription> {
public:
    ThingBuilder(const RnUid& id, const wchar_t* ofCategory, const wchar_t* called) {
        classId = id;
        category = ofCategory;
        name = called;
    }
};

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
        category = L"Thing";
        name = called;
    }
    RnEnum::Action enumerateExtensions(RnEnumerator<const wchar_t*>& visitor) override {
        for (const wchar_t* extension : extensions) {
            if (const auto action = visitor.visit(extension)) return action;
        }
        return visitor.finish();
    }
    bool canImport(RnBufferedIO* io) override {
        const long position = io->seek(0, 1);
        const bool accepted = read(*io) == start;
        io->seek(position, 0);
        return accepted;
    }
    RnRef<RnCastable> import(RnPtr<RnBufferedIO> io, const wchar_t* called, const wchar_t* basePath) override {
        auto thing = rnCreate<ThingObject>();
        thing->classId = classId;
        thing->name = called;
        thing->basePath = basePath;
        thing->firstBytes = read(*io);
        return thing;
    }

private:
    std::string read(RnBufferedIO& io) const {
        std::string bytes(start.size(), '\0');
        bytes.resize(static_cast<std::size_t>(io.readBytes(bytes.data(), static_cast<int>(bytes.size()))));
        return bytes;
    }

    std::string start;
    std::vector<const wchar_t*> extensions;
};

class ThingRegistry : public RnCastImpl<RnComponentRegistry, RnComponentRegistry> {
public:
    explicit ThingRegistry(std::vector<RnComponentBuilder*> all) : _builders(std::move(all)) {}

    RnRef<RnComponentBuilder> getBuilder(const RnUid& classId) override {
        for (RnComponentBuilder* builder : _builders) {
            if (builder->getClassId() == classId) return builder->getBuilder();
        }
        return {};
    }
    int getVersion() const override { return 1; }
    const wchar_t* getLegalNotice() const override { return L""; }
    const wchar_t* getVendor() const override { return L""; }
    std::uint32_t getBuilderCount() const override { return static_cast<std::uint32_t>(_builders.size()); }
    RnEnum::Action enumerateBuilders(RnEnumerator<RnPtr<RnComponentBuilder>>& visitor) override {
        for (RnComponentBuilder* builder : _builders) {
            if (const auto action = visitor.visit(builder)) return action;
        }
        return visitor.finish();
    }

private:
    std::vector<RnComponentBuilder*> _builders;
};

}  // namespace Ov
