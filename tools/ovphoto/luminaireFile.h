#pragma once

#include <optional>
#include <string>
#include <vector>

#include "tools/ovphoto/conversionLoss.h"
#include "tools/ovphoto/fileFacts.h"
#include "tools/ovphoto/hostSession.h"

// Between files and lights.

namespace OvTool {

using WebLight = Ov::RnRef<Ov::RnWebIntensityDist>;

/// A light as a file that is not yet in its place.
struct LuminaireFile {
    std::string bytes;
    WebLight light;           // as the format's reader reads it, in candela; null when it refuses to
    float lampLumens = 0;     // that it stands for; 0: none
    std::string refusal;      // then why
    std::vector<Fact> facts;  // as they are read
};

/// Writes a light for `file` and reads it again. None after messages, to which the writer's are added.
std::optional<LuminaireFile> makeFile(const HostSession& session, const std::string& file, const Format& target,
                                      Ov::RnIntensityDist& light, Ov::FileForm form,
                                      const std::vector<Fact>& facts, std::vector<std::string>& messages);

/// What a user should know of a file that differs from the light by `loss`.
std::vector<std::string> lossWarnings(const ConversionLoss& loss, const Format& target,
                                      const Ov::RnIntensityDist& light, const LuminaireFile& made);

}  // namespace OvTool
