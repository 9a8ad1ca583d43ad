#pragma once

#include "components/photo/lid/lidBuilder.h"
#include "host/componentManager/importer.h"
#include "ovphoto/classIds.h"
#include "ovphoto/photoFormat.h"

namespace OvPhotometrics {

/// Imports photometric files without being told their format. The one in the registry is not counted; those that
/// `create` makes are.
class LidImporter
    : public InfoBuilder<
          Ov::RnCastHeap<LidImporter>,
          Ov::RnCastImpl2<LidBuilder, Ov::RnBaseImporter, Ov::RnComponentBuilder, Ov::RnBuilderDescription>> {
public:
    static constexpr BuilderInfo info{classIds::importer, photometricWebCategory, L"LID Importer",
                                      L"Photometric file importer."};

    bool isCreatable() const override { return false; }
    const wchar_t* getImportCategory() const override { return info.category; }
    /// Visits the builders in the order of their formats' preference, equals in that of their names, so that the first
    /// that accepts an input is the one to take.
    Ov::RnEnum::Action enumerateObjects(Ov::RnEnumerator<Ov::RnCPtr<Ov::RnImportBuilder>>& visitor) override;
};

}  // namespace OvPhotometrics
