#pragma once

#include <cstdint>

namespace Ov {

/// A 16-byte id of an interface or of a creatable class. Class ids stand in saved streams and never change.
struct RnUid {
    /// @{
    /// The id's words, as they stand in streams.
    std::uint32_t w0 = 0;
    std::uint32_t w1 = 0;
    std::uint32_t w2 = 0;
    std::uint32_t w3 = 0;
    /// @}

    /// Whether all words are equal.
    friend constexpr bool operator==(const RnUid&, const RnUid&) = default;
};

}  // namespace Ov
