#include "components/module/fileExports.h"

#include <new>

#include "components/messageFile/messageIds.h"
#include "components/photo/files/fileFormat.h"
#include "components/photo/lid/component.h"
#include "components/photo/lid/reportMessage.h"

namespace OvPhotometrics {

namespace {

void visitAll(const FileFacts& facts, Ov::RnEnumerator<const FileFact&>& visitor) {
    for (const auto& [key, text] : facts)
        if (visitor.visit({key.c_str(), text.c_str()}) != Ov::RnEnum::goOn) return;
    visitor.finish();
}

}  // namespace

bool writeFile(const Ov::RnUid& classId, Ov::RnIntensityDist& distribution, Ov::RnStream& out, FileForm form,
               const FileFact* facts, std::int32_t count) {
    FileFormat* const format = formatOf(builderTable().find(classId));
    if (!format) return false;
    try {
        FileFacts given;
        for (std::int32_t i = 0; i < count; ++i) given.add(facts[i].key, std::wstring(facts[i].text));
        return format->write(distribution, out, form, given);
    } catch (const std::bad_alloc&) {
        reportMessage(messages::outOfMemory);
        return false;
    }
}

bool readFileFacts(Ov::RnBufferedIO& io, const Ov::RnUid* format, const wchar_t* basePath,
                   Ov::RnEnumerator<const FileFact&>& visitor) {
    FileFormat* const reader = format ? formatOf(builderTable().find(*format)) : recognise(io);
    FileFacts facts;
    if (!reader || !reader->readFacts(io, basePath, facts)) return false;
    visitAll(facts, visitor);
    return true;
}

Ov::RnRef<Ov::RnCastable> importWithFacts(Ov::RnBufferedIO& io, const Ov::RnUid& format, const wchar_t* name,
                                          const wchar_t* basePath, Ov::RnEnumerator<const FileFact&>& visitor) {
    FileFormat* const reader = formatOf(builderTable().find(format));
    if (!reader) return {};
    FileFacts facts;
    auto web = reader->importWithFacts(io, name, basePath, facts);
    visitAll(facts, visitor);
    return web;
}

}  // namespace OvPhotometrics
