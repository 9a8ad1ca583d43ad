#include "host/componentManager/importer.h"

#include <algorithm>
#include <vector>

#include "components/support/file.h"
#include "components/support/path.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/streamEx.h"

namespace Ov {

namespace {

RnRef<RnComponentManager> componentManager() { return rnCast<RnComponentManager>(RnGetComponentManager()); }

struct NamedBuilder {
    const wchar_t* name;
    RnRef<RnImportBuilder> builder;
};

std::vector<NamedBuilder> importBuilders(const wchar_t* category) {
    std::vector<NamedBuilder> found;
    for (const auto& builder : componentManager()->builders(category)) {
        auto importBuilder = rnQuery<RnImportBuilder>(builder.get());
        if (importBuilder) found.push_back({builder->getName(), std::move(importBuilder)});
    }
    return found;
}

/// Adds the patterns of a builder's extensions that are not there yet.
void addPatterns(std::vector<std::wstring>& patterns, RnImportBuilder& builder) {
    auto visitor = rnVisitor<const wchar_t*>([&](const wchar_t* extension) {
        const std::wstring pattern = std::wstring(L"*.") + extension;
        if (std::find(patterns.begin(), patterns.end(), pattern) == patterns.end()) patterns.push_back(pattern);
    });
    builder.enumerateExtensions(visitor);
}

std::wstring joined(const std::vector<std::wstring>& patterns) {
    std::wstring text;
    for (const std::wstring& pattern : patterns) text += (text.empty() ? L"" : L";") + pattern;
    return text;
}

std::wstring fileType(const std::wstring& name, const std::vector<std::wstring>& patterns) {
    return name + L" (" + joined(patterns) + L")|" + joined(patterns);
}

std::vector<std::wstring> allPatterns(const std::vector<NamedBuilder>& builders) {
    std::vector<std::wstring> patterns;
    for (const NamedBuilder& each : builders) addPatterns(patterns, *each.builder);
    return patterns;
}

/// The first builder of an importer's walk that accepts the input, or null.
RnRef<RnImportBuilder> recognise(RnBaseImporter& importer, RnBufferedIO* io) {
    RnRef<RnImportBuilder> found;
    auto visitor = rnVisitor<RnCPtr<RnImportBuilder>>([&](RnCPtr<RnImportBuilder> each) {
        auto* const builder = const_cast<RnImportBuilder*>(each.get());
        if (!builder->canImport(io)) return RnEnum::goOn;
        found = RnRef<RnImportBuilder>::share(builder);
        return RnEnum::stop;
    });
    importer.enumerateObjects(visitor);
    return found;
}

}  // namespace

RnEnum::Action RnBaseImporter::enumerateObjects(RnEnumerator<RnCPtr<RnImportBuilder>>& visitor) {
    for (const NamedBuilder& each : importBuilders(getImportCategory())) {
        const RnEnum::Action action = visitor.visit(each.builder.get());
        if (action != RnEnum::goOn) return action;
    }
    return visitor.finish();
}

const wchar_t* RnBaseImporter::getFileTypes() {
    const std::vector<NamedBuilder> builders = importBuilders(getImportCategory());
    _fileTypes = builders.empty() ? L"" : fileType(L"All", allPatterns(builders));
    for (const NamedBuilder& each : builders) {
        std::vector<std::wstring> patterns;
        addPatterns(patterns, *each.builder);
        _fileTypes += L"|" + fileType(each.name, patterns);
    }
    return _fileTypes.c_str();
}

const wchar_t* RnBaseImporter::getDefaultSearch() {
    _search = joined(allPatterns(importBuilders(getImportCategory())));
    return _search.c_str();
}

RnRef<RnCastable> RnBaseImporter::import(const wchar_t* path, const wchar_t* basePath, bool& recognised) {
    recognised = false;
    const RnRef<RnBufferedIO> io = openInputFile(path);
    if (!io) {
        throw RnStreamEx::ExReadError("host/componentManager/importer", __LINE__, openFailure(path).c_str());
    }
    const RnRef<RnImportBuilder> builder = recognise(*this, io.get());
    if (!builder) return {};
    recognised = true;
    const std::wstring folder = basePath && *basePath ? basePath : pathFolder(path);
    return builder->import(io.get(), pathStem(path).c_str(), folder.c_str());
}

RnRef<RnCastable> RnBaseImporter::import(const wchar_t* path, const wchar_t* basePath) {
    bool recognised = false;
    return import(path, basePath, recognised);
}

RnRef<RnCastable> RnBaseImporter::import(RnPtr<RnBufferedIO> io, const wchar_t* name, const wchar_t* basePath) {
    const RnRef<RnImportBuilder> builder = recognise(*this, io.get());
    return builder ? builder->import(io, name, basePath) : RnRef<RnCastable>();
}

}  // namespace Ov
