#include "components/photo/files/recognition.h"

#include <new>

#include "host/componentManager/componentManager.h"
#include "host/componentManager/importer.h"
#include "ovphoto/classIds.h"

namespace OvPhotometrics {

Ov::RnUid recognisedClass(Ov::RnBufferedIO& io) {
    const auto manager = Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager());
    const auto importer = Ov::rnQuery<Ov::RnImporter>(manager->createObject(classIds::importer).get());
    if (!importer) throw std::bad_alloc();
    Ov::RnUid found;
    auto visitor = Ov::rnVisitor<Ov::RnCPtr<Ov::RnImportBuilder>>([&](Ov::RnCPtr<Ov::RnImportBuilder> builder) {
        // A walk shows builders as constant, but asks nothing of those that it visits.
        auto* const asked = const_cast<Ov::RnImportBuilder*>(builder.get());
        if (!asked->canImport(&io)) return Ov::RnEnum::goOn;
        found = Ov::rnCast<Ov::RnComponentBuilder>(asked)->getClassId();
        return Ov::RnEnum::stop;
    });
    importer->enumerateObjects(visitor);
    return found;
}

}  // namespace OvPhotometrics
