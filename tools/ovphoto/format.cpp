#include "tools/ovphoto/format.h"

#include <algorithm>

#include "components/support/path.h"
#include "host/componentManager/importer.h"
#include "ovphoto/classIds.h"

namespace OvTool {

using namespace Ov;

namespace {

/// ASCII letters, whatever the locale.
std::string lowered(std::string_view text) {
    std::string lower(text);
    for (char& c : lower)
        if (c >= 'A' && c <= 'Z') c = static_cast<char>(c - 'A' + 'a');
    return lower;
}

std::string extensionOf(RnImportBuilder& builder) {
    std::string extension;
    auto takeFirst = rnVisitor<const wchar_t*>([&extension](const wchar_t* text) {
        extension = toUtf8(text);
        return RnEnum::stop;
    });
    builder.enumerateExtensions(takeFirst);
    return extension;
}

/// "IES" for the builder named "IES Web".
std::string nameOf(const RnBuilderDescription& builder) {
    const std::string name = toUtf8(builder.getName());
    return name.substr(0, name.find(' '));
}

Format formatOf(RnImportBuilder& builder) {
    Format format;
    format.builder = RnRef<RnImportBuilder>::share(&builder);
    format.described = rnCast<RnComponentBuilder>(&builder);
    format.own = rnQuery<RnPhotoFormat>(&builder);
    if (format.own) format.traits = format.own->getTraits();
    format.name = format.own ? toUtf8(format.traits.name) : nameOf(*format.described);
    format.extension = extensionOf(builder);
    return format;
}

}  // namespace

Formats::Formats(RnComponentManager& manager) {
    const auto importer = rnCast<RnImporter>(manager.createObject(OvPhotometrics::classIds::importer).get());
    auto visitor = rnVisitor<RnCPtr<RnImportBuilder>>([this](RnCPtr<RnImportBuilder> builder) {
        _formats.push_back(formatOf(const_cast<RnImportBuilder&>(*builder)));  // a walk shows them as constant
    });
    importer->enumerateObjects(visitor);
}

const Format* Formats::named(std::string_view name) const {
    const auto found =
        std::find_if(begin(), end(), [&](const Format& format) { return lowered(format.name) == lowered(name); });
    return found == end() ? nullptr : &*found;
}

const Format* Formats::ofExtension(const std::string& path) const {
    const std::string extension = lowered(toUtf8(widePath(nativePath(fromUtf8(path)).extension())));
    const auto found =
        std::find_if(begin(), end(), [&](const Format& format) { return "." + format.extension == extension; });
    return found == end() ? nullptr : &*found;
}

const Format* Formats::ofClass(const RnUid& classId) const {
    const auto found = std::find_if(
        begin(), end(), [&](const Format& format) { return format.described->getClassId() == classId; });
    return found == end() ? nullptr : &*found;
}

const Format* Formats::recognise(RnBufferedIO& io) const {
    const auto found =
        std::find_if(begin(), end(), [&](const Format& format) { return format.builder->canImport(&io); });
    return found == end() ? nullptr : &*found;
}

std::string Formats::list(std::string Format::*text) const {
    std::string all;
    for (const Format& format : _formats) all += (all.empty() ? "" : ",") + format.*text;
    return all;
}

}  // namespace OvTool
