#pragma once

#include <string>
#include <vector>

#include "host/componentManager/stream.h"
#include "ovphoto/naturalLight.h"
#include "ovphoto/numberedExports.h"
#include "tools/ovphoto/hostSession.h"

namespace OvTool {

/// A new object of the module. Raises ExModule when the module builds none.
Ov::RnRef<Ov::RnNaturalLight> createDaylight(const HostSession& session);

/// Loads saved settings of either form into the object. False, with the reasons, when they are refused; then the
/// object is as it was. Reasons may also tell what is odd about a file that was taken.
bool loadDaylight(Ov::RnNaturalLight& naturalLight, const std::string& file, std::vector<std::string>& reasons);

/// What the object's own save writes.
std::string savedDaylight(Ov::RnNaturalLight& naturalLight, Ov::RnStream::Form form);

/// "41 deg N, 74 deg W, UTC-5:00".
std::string siteText(const Ov::RnNaturalLight& naturalLight, const OvPhotometrics::NumberedFunctions& functions);

/// Which settings lie outside their ranges, and what is computed with instead.
std::vector<std::string> outOfRange(const Ov::RnNaturalLight& naturalLight);

/// "clear", "partly cloudy" or "overcast", in the user's language.
const char* skyText(float cover);

/// "21 June, day 172".
std::string dateText(const Ov::RnNaturalLight& naturalLight, const OvPhotometrics::NumberedFunctions& functions);

}  // namespace OvTool
