#include "components/photo/lid/importer.h"

#include <algorithm>
#include <utility>
#include <vector>

namespace OvPhotometrics {

namespace {

using Builder = Ov::RnCPtr<Ov::RnImportBuilder>;

int preferenceOf(Ov::RnImportBuilder& builder) {
    const auto format = Ov::rnQuery<Ov::RnPhotoFormat>(&builder);
    return format ? format->getTraits().preference : Ov::PhotoFormatTraits().preference;
}

}  // namespace

Ov::RnEnum::Action LidImporter::enumerateObjects(Ov::RnEnumerator<Builder>& visitor) {
    std::vector<std::pair<int, Ov::RnRef<Ov::RnImportBuilder>>> builders;
    auto collect = Ov::rnVisitor<Builder>([&](Builder each) {
        auto* const builder = const_cast<Ov::RnImportBuilder*>(each.get());  // a walk shows builders as constant
        const int preference = preferenceOf(*builder);
        const auto isBefore = [](int one, const auto& other) { return one < other.first; };
        builders.emplace(std::upper_bound(builders.begin(), builders.end(), preference, isBefore), preference,
                         Ov::RnRef<Ov::RnImportBuilder>::share(builder));
    });
    Ov::RnBaseImporter::enumerateObjects(collect);
    for (const auto& [preference, builder] : builders)
        if (const auto action = visitor.visit(builder.get()); action != Ov::RnEnum::goOn) return action;
    return visitor.finish();
}

}  // namespace OvPhotometrics
