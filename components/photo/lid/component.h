#pragma once

#include <array>
#include <cstddef>
#include <memory_resource>
#include <unordered_map>

#include "components/support/castImpl.h"
#include "components/support/immortal.h"
#include "host/componentManager/builder.h"

namespace OvPhotometrics {

using Ov::immortal;

/// Every builder of the library by class id. One table a process; it is filled before the module's first call and
/// only read afterwards. Neither table nor builders are ever freed; as static storage they go with the module.
class BuilderTable {
public:
    /// Enters a builder, which must stay. The first of a class id is kept.
    void add(Ov::RnComponentBuilder& builder);
    Ov::RnComponentBuilder* find(const Ov::RnUid& classId) const;

    std::size_t size() const { return _builders.size(); }
    auto begin() const { return _builders.begin(); }
    auto end() const { return _builders.end(); }

private:
    struct Hash {
        std::size_t operator()(const Ov::RnUid* id) const { return id->w0; }
    };
    struct Equal {
        bool operator()(const Ov::RnUid* a, const Ov::RnUid* b) const { return *a == *b; }
    };
    std::array<std::byte, 2048> _memory;  // enough for dozens of builders
    std::pmr::monotonic_buffer_resource _resource{_memory.data(), _memory.size()};
    std::pmr::unordered_map<const Ov::RnUid*, Ov::RnComponentBuilder*, Hash, Equal> _builders{&_resource};
};

/// Made on first use.
BuilderTable& builderTable();

/// The registry that the module's entry point answers; all it says comes from the builder table.
class LidComponent final : public Ov::RnCastImpl<Ov::RnComponentRegistry, Ov::RnComponentRegistry> {
public:
    LidComponent() { builderTable(); }

    Ov::RnRef<Ov::RnComponentBuilder> getBuilder(const Ov::RnUid& classId) override;
    int getVersion() const override { return 1; }
    const wchar_t* getLegalNotice() const override;
    const wchar_t* getVendor() const override;
    std::uint32_t getBuilderCount() const override;
    Ov::RnEnum::Action enumerateBuilders(Ov::RnEnumerator<Ov::RnPtr<Ov::RnComponentBuilder>>& visitor) override;
};

LidComponent& lidComponent();

}  // namespace OvPhotometrics
