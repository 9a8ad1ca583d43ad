#pragma once

#include <memory>
#include <string>
#include <vector>

#include "host/componentManager/builder.h"

namespace Ov {

class Module;

/// A module cannot be loaded: no such file, not a module, or without the entry point. Also caught as
/// std::runtime_error.
class OVHOST_API ExModule : public ExBase, public std::runtime_error {
public:
    /// `reason` names the file and what is wrong with it.
    explicit ExModule(const std::string& reason);
    ~ExModule() override;
};

/// The host's register of modules and of the classes that they build. Of builders with the same class id the one
/// that was registered first counts.
///
/// Threads:  any number may create and find at once, while nobody registers, loads or unloads.
class OVHOST_API RnComponentManager : public RnCastable {
public:
    /// Id of the interface.
    [[gnu::used]] static constexpr RnUid iid{0xad148684, 0x719a11d1, 0xa3bb0060, 0x9707609d};

    /// A new object of a registered class; null when no builder has the class id or there is no memory.
    virtual RnRef<RnCastable> createObject(const RnUid& classId) = 0;

    /// Loads the module at `path`, calls its entry point and registers what it answers. Raises ExModule, and then
    /// nothing is loaded, for a null path too. The module stays loaded until it is unloaded or the process ends; loading the same file
    /// again, by whatever path, gives the same module.
    virtual const Module& loadModule(const wchar_t* path) = 0;
    /// Takes the module's builders out of the register and unloads it; a module that is not loaded is ignored. No
    /// object of it may be left.
    virtual void unloadModule(const wchar_t* path) = 0;

    /// @{
    /// Registers and unregisters the builders of a registry that lives in this process; a registry counts once.
    virtual void addRegistry(RnComponentRegistry& registry) = 0;
    virtual void removeRegistry(RnComponentRegistry& registry) = 0;
    /// @}

    /// The builder of a class with a new reference, or null.
    virtual RnRef<RnComponentBuilder> findBuilder(const RnUid& classId) = 0;
    /// All builders, or those of one category, by category and name.
    virtual std::vector<RnRef<RnComponentBuilder>> builders(const wchar_t* category = nullptr) = 0;
};

/// The host's component manager, as an object to be cast to RnComponentManager.
OVHOST_API RnCastable* RnGetComponentManager();

}  // namespace Ov
