#pragma once

#include "components/support/castImpl.h"
#include "host/componentManager/builder.h"

namespace OvPhotometrics {

/// What a builder says of the class that it builds.
struct BuilderInfo {
    Ov::RnUid classId;
    const wchar_t* category;
    const wchar_t* name;
    const wchar_t* description;
};

inline constexpr const wchar_t* photometricWebCategory = L"Photometric Web";
inline constexpr const wchar_t* distributionCategory = L"Light Intensity Distribution";

/// The texts that the registry and every builder give.
inline constexpr const wchar_t* legalNotice = L"Copyright the ovphoto authors. MIT licence.";
inline constexpr const wchar_t* vendor = L"The ovphoto authors";

/// Base of every builder of the library.
class LidBuilder : public Ov::RnComponentBuilder {
public:
    const wchar_t* getLegalNotice() const override { return legalNotice; }
    const wchar_t* getVendor() const override { return vendor; }
    int getVersion() const override { return 1; }
    bool isCreatable() const override { return true; }
};

/// A builder's answers from `T::info`, over `Base`, a LidBuilder that answers the castable operations.
template <class T, class Base>
class InfoBuilder : public Base {
public:
    const Ov::RnUid& getClassId() const override { return T::info.classId; }
    const wchar_t* getCategory() const override { return T::info.category; }
    const wchar_t* getName() const override { return T::info.name; }
    const wchar_t* getDescription() const override { return T::info.description; }
    Ov::RnRef<Ov::RnCastable> create() override { return Ov::rnCreateOrNull<T>(); }
};

/// Builds objects of a class that no file is imported into.
template <class T>
using ObjectBuilder = InfoBuilder<T, Ov::RnCastImpl<LidBuilder, Ov::RnComponentBuilder, Ov::RnBuilderDescription>>;

}  // namespace OvPhotometrics
