#pragma once

#include "ovphoto/classIds.h"
#include "ovphoto/numberedExports.h"

// Files in any of the formats, as the numbered exports offer them; their contract stands there.

namespace OvPhotometrics {

/// Writes in the format whose webs have the class id.
bool writeFile(const Ov::RnUid& classId, Ov::RnIntensityDist& distribution, Ov::RnStream& out, FileForm form,
               const FileFact* facts, std::int32_t count);

template <const Ov::RnUid& classId>
bool writeFileOf(Ov::RnIntensityDist& distribution, Ov::RnStream& out, FileForm form, const FileFact* facts,
                 std::int32_t count) {
    return writeFile(classId, distribution, out, form, facts, count);
}
inline constexpr auto& writeIes = writeFileOf<classIds::iesWeb>;
inline constexpr auto& writeCibse = writeFileOf<classIds::cibseWeb>;
inline constexpr auto& writeNimb = writeFileOf<classIds::nimbWeb>;
inline constexpr auto& writeTbt = writeFileOf<classIds::tbtWeb>;

bool readFileFacts(Ov::RnBufferedIO& io, const Ov::RnUid* format, const wchar_t* basePath,
                   Ov::RnEnumerator<const FileFact&>& visitor);
Ov::RnRef<Ov::RnCastable> importWithFacts(Ov::RnBufferedIO& io, const Ov::RnUid& format, const wchar_t* name,
                                          const wchar_t* basePath, Ov::RnEnumerator<const FileFact&>& visitor);

}  // namespace OvPhotometrics
