#pragma once

#include <cstdint>

namespace Ov {

/// Whether the resources of a file mapped as an image can be read without harm: their section lies inside the
/// file, their tables and data in that section, and string resources in their data. The system takes all that for
/// granted, and would read behind the end.
bool resourcesAreSound(const void* image, std::uintmax_t fileSize);

}  // namespace Ov
