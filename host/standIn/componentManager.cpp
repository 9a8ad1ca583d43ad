#include "host/componentManager/componentManager.h"

#include <algorithm>
#include <cwchar>

#include "components/support/castImpl.h"
#include "components/support/immortal.h"
#include "components/support/path.h"
#include "host/componentManager/module.h"

namespace Ov {

ExModule::ExModule(const std::string& reason) : ExBase(reason.c_str()), std::runtime_error(reason) {}

ExModule::~ExModule() = default;

namespace {

using Builder = RnRef<RnComponentBuilder>;

bool byCategoryAndName(const Builder& a, const Builder& b) {
    const int order = std::wcscmp(a->getCategory(), b->getCategory());
    return order != 0 ? order < 0 : std::wcscmp(a->getName(), b->getName()) < 0;
}

/// Whether `path` leads to the file of `module`, which may have been renamed or deleted since.
bool isModuleAt(const Module& module, const std::filesystem::path& path) {
    std::error_code ignored;
    const std::filesystem::path loaded = nativePath(module.path());
    return std::filesystem::absolute(path, ignored) == loaded ||
           std::filesystem::equivalent(path, loaded, ignored);
}

class ComponentManager final : public RnCastImpl<RnComponentManager, RnComponentManager> {
public:
    RnRef<RnCastable> createObject(const RnUid& classId) override;
    const Module& loadModule(const wchar_t* path) override;
    void unloadModule(const wchar_t* path) override;
    void addRegistry(RnComponentRegistry& registry) override;
    void removeRegistry(RnComponentRegistry& registry) override;
    Builder findBuilder(const RnUid& classId) override;
    std::vector<Builder> builders(const wchar_t* category) override;

private:
    using Modules = std::vector<std::unique_ptr<Module>>;

    Modules::iterator findModule(const wchar_t* path);

    Modules _modules;
    std::vector<RnComponentRegistry*> _registries;  // in order of registration
};

ComponentManager::Modules::iterator ComponentManager::findModule(const wchar_t* path) {
    const std::filesystem::path native = nativePath(path);
    return std::find_if(_modules.begin(), _modules.end(),
                        [&](const auto& module) { return isModuleAt(*module, native); });
}

const Module& ComponentManager::loadModule(const wchar_t* path) {
    if (!path) throw ExModule("no path of a module is given");
    const auto known = findModule(path);
    if (known != _modules.end()) return **known;

    auto module = std::make_unique<Module>(path);
    _modules.reserve(_modules.size() + 1);  // so that nothing fails once the module is registered
    addRegistry(module->registry());
    return *_modules.emplace_back(std::move(module));
}

void ComponentManager::unloadModule(const wchar_t* path) {
    if (!path) return;
    const auto known = findModule(path);
    if (known == _modules.end()) return;
    removeRegistry((*known)->registry());
    _modules.erase(known);
}

void ComponentManager::addRegistry(RnComponentRegistry& registry) {
    const auto known = std::find(_registries.begin(), _registries.end(), &registry);
    if (known == _registries.end()) _registries.push_back(&registry);
}

void ComponentManager::removeRegistry(RnComponentRegistry& registry) { std::erase(_registries, &registry); }

RnRef<RnCastable> ComponentManager::createObject(const RnUid& classId) {
    const Builder builder = findBuilder(classId);
    return builder ? builder->create() : RnRef<RnCastable>();
}

Builder ComponentManager::findBuilder(const RnUid& classId) {
    for (RnComponentRegistry* registry : _registries) {
        if (Builder builder = registry->getBuilder(classId)) return builder;
    }
    return {};
}

std::vector<Builder> ComponentManager::builders(const wchar_t* category) {
    std::vector<Builder> found;
    auto visitor = rnVisitor<RnPtr<RnComponentBuilder>>([&](RnPtr<RnComponentBuilder> builder) {
        if (category && std::wcscmp(builder->getCategory(), category) != 0) return;
        const bool counts = findBuilder(builder->getClassId()).get() == builder.get();
        if (counts) found.push_back(builder->getBuilder());
    });
    for (RnComponentRegistry* registry : _registries) registry->enumerateBuilders(visitor);
    std::sort(found.begin(), found.end(), byCategoryAndName);
    return found;
}

}  // namespace

RnCastable* RnGetComponentManager() {
    // Objects of a module may outlive everything else of the process.
    return &immortal<ComponentManager>();
}

}  // namespace Ov
