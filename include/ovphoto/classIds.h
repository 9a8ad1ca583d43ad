#pragma once

#include "host/componentManager/uid.h"

/// Class ids of what the module creates. They stand in saved streams and never change.
namespace OvPhotometrics::classIds {

/// The ids differ in their first word.
constexpr Ov::RnUid make(std::uint32_t w0) { return {w0, 0xe42611d1, 0xaaab6e3d, 0xf2000000}; }

inline constexpr Ov::RnUid importer = make(0x3debf400);         ///< Ov::RnImporter
inline constexpr Ov::RnUid isotropic = make(0x3debf500);        ///< Ov::RnIsotropicIntensityDist
inline constexpr Ov::RnUid diffuse = make(0x3debf600);          ///< Ov::RnDiffuseIntensityDist
inline constexpr Ov::RnUid spotlight = make(0x3debf700);        ///< Ov::RnSpotlightIntensityDist
inline constexpr Ov::RnUid webDistribution = make(0x3debf800);  ///< Ov::RnWebIntensityDist
inline constexpr Ov::RnUid cibseWeb = make(0x3debf900);         ///< Ov::RnPhotoWebData of a CIBSE TM14 file
inline constexpr Ov::RnUid iesWeb = make(0x3debfa00);           ///< Ov::RnPhotoWebData of an IES LM-63 file
inline constexpr Ov::RnUid nimbWeb = make(0x3debfb00);          ///< Ov::RnPhotoWebData of a NIMB file
inline constexpr Ov::RnUid tbtWeb = make(0x3debfc00);           ///< Ov::RnPhotoWebData of a TBT file
inline constexpr Ov::RnUid naturalLight = make(0x3debfd00);     ///< Ov::RnNaturalLight

}  // namespace OvPhotometrics::classIds
