#include "tools/ovphoto/luminaireFile.h"

#include <cmath>

#include "components/support/devices.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/fileAngles.h"
#include "tools/ovphoto/messageCollector.h"

namespace OvTool {

using namespace Ov;

namespace {

constexpr double tolerated = 1;  // per cent, of fluxes

std::optional<std::string> fileBytes(const Format& target, RnIntensityDist& light, FileForm form,
                                     const std::vector<Fact>& facts, std::vector<std::string>& messages) {
    std::vector<FileFact> given;
    for (const Fact& fact : facts) given.push_back({fact.kind, fact.key.c_str(), fact.text.c_str()});
    const auto buffer = rnCreate<RnMemoryBuffer>();
    RnStream stream(buffer.get(), RnStream::Form::text);
    const MessageCollector collector(messages);
    const std::size_t before = messages.size();
    const auto count = static_cast<std::int32_t>(given.size());
    if (target.own && target.own->write(light, stream, form, given.data(), count)) return buffer->bytes();
    if (messages.size() == before) messages.push_back("the module does not write this as " + target.name);
    return {};
}

}  // namespace

std::optional<LuminaireFile> makeFile(const HostSession& session, const std::string& file, const Format& target,
                                      RnIntensityDist& light, FileForm form, const std::vector<Fact>& facts,
                                      std::vector<std::string>& messages) {
    auto bytes = fileBytes(target, light, form, facts, messages);
    if (!bytes) return {};
    LuminaireFile made{std::move(*bytes), {}, 0, {}, {}};
    ReadResult again = session.readBytes(made.bytes, file, target.name);
    if (again.web) {
        made.light = session.lightOf(*again.web);
        made.lampLumens = fileInfoOf(*again.web).lampLumens;
        made.facts = std::move(again.facts);
    } else {
        made.refusal = "the output is no readable " + target.name + " file";
        for (const std::string& reason : again.told()) made.refusal += ": " + reason;
    }
    return made;
}

std::vector<std::string> lossWarnings(const ConversionLoss& loss, const Format& target,
                                      const RnIntensityDist& light, const LuminaireFile& made) {
    std::vector<std::string> warnings;
    const double lamps = light.getFlux();
    if (!target.traits.holdsLampLumens && made.lampLumens > 0 &&
        std::abs(made.lampLumens - lamps) > lamps * tolerated / 100)
        warnings.push_back(target.name + " holds no flux of lamps: readers take " + shortNumber(made.lampLumens) +
                           " lm instead of " + shortNumber(lamps) + " lm");
    if (loss.candelaPercent > keptPercent) {
        warnings.push_back("the candela differ by up to " + shortNumber(loss.candela) + " cd, " +
                           shortNumber(loss.candelaPercent) + " % of the peak");
    }
    if (loss.rimCandela > 0) {
        const std::string apart = shortNumber(loss.rimCandela) + " cd";
        warnings.push_back(
            "at the rim of its range, or a pole where planes disagree, the light differs by up to " + apart);
    }
    if (std::abs(loss.fluxPercent) > tolerated)
        warnings.push_back("the flux of the luminaire differs by " + shortNumber(loss.fluxPercent) + " %");
    return warnings;
}

}  // namespace OvTool
