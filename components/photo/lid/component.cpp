#include "components/photo/lid/component.h"

#include "components/photo/lid/lidBuilder.h"

namespace OvPhotometrics {

void BuilderTable::add(Ov::RnComponentBuilder& builder) { _builders.try_emplace(&builder.getClassId(), &builder); }

Ov::RnComponentBuilder* BuilderTable::find(const Ov::RnUid& classId) const {
    const auto found = _builders.find(&classId);
    return found == _builders.end() ? nullptr : found->second;
}

BuilderTable& builderTable() { return immortal<BuilderTable>(); }

LidComponent& lidComponent() { return immortal<LidComponent>(); }

Ov::RnRef<Ov::RnComponentBuilder> LidComponent::getBuilder(const Ov::RnUid& classId) {
    return Ov::RnRef<Ov::RnComponentBuilder>::share(builderTable().find(classId));
}

const wchar_t* LidComponent::getLegalNotice() const { return legalNotice; }

const wchar_t* LidComponent::getVendor() const { return vendor; }

std::uint32_t LidComponent::getBuilderCount() const { return static_cast<std::uint32_t>(builderTable().size()); }

Ov::RnEnum::Action LidComponent::enumerateBuilders(Ov::RnEnumerator<Ov::RnPtr<Ov::RnComponentBuilder>>& visitor) {
    for (const auto& [classId, builder] : builderTable())
        if (const auto action = visitor.visit(builder); action != Ov::RnEnum::goOn) return action;
    return visitor.finish();
}

}  // namespace OvPhotometrics
