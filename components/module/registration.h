#pragma once

namespace OvPhotometrics {

/// Enters every builder of the library into the builder table, in their order. Called again it changes nothing.
void registerBuilders();

}  // namespace OvPhotometrics
