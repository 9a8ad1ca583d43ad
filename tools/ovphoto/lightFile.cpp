#include "tools/ovphoto/lightFile.h"

#include <cmath>

#include "host/componentManager/devices.h"
#include "tools/ovphoto/messageCollector.h"
#include "tools/ovphoto/numbers.h"
#include "tools/ovphoto/scaledWeb.h"

namespace OvTool {

using namespace Ov;

namespace {

constexpr double tolerated = 1;  // per cent

/// The factor from the values of a file to candela.
float candelaUnit(const std::string& format, const std::vector<Fact>& facts) {
    const float flux = factNumber(facts, L"flux").value_or(0);
    const float reference = factNumber(facts, L"referenceFlux").value_or(0);
    return format == "TBT" && flux > 0 && reference > 0 ? flux / reference : 1;
}

/// The light of a web whose candela and flux are to be multiplied.
WebLight scaledLight(const HostSession& session, const RnRef<RnPhotoWebData>& web, float candela, float flux) {
    if (candela == 1 && flux == 1) return session.distribute(*web, web->getLumens());
    const auto scaled = rnCreate<ScaledWeb>(web, candela, flux);
    return session.distribute(*scaled, scaled->getLumens());
}

std::optional<std::string> fileBytes(const HostSession& session, const TargetFormat& target,
                                     RnIntensityDist& light, OvPhotometrics::FileForm form,
                                     const std::vector<Fact>& facts, std::vector<std::string>& messages) {
    std::vector<OvPhotometrics::FileFact> given;
    for (const Fact& fact : facts) given.push_back({fact.key.c_str(), fact.text.c_str()});
    const auto buffer = rnCreate<RnMemoryBuffer>();
    RnStream stream(buffer.get(), RnStream::Form::text);
    const MessageCollector collector(messages);
    const std::size_t before = messages.size();
    const auto write = session.functions().*target.write;
    if (write(light, stream, form, given.data(), static_cast<std::int32_t>(given.size()))) return buffer->bytes();
    if (messages.size() == before)
        messages.push_back(std::string("the module does not write this as ") + target.name);
    return {};
}

}  // namespace

WebLight lightOf(const HostSession& session, const ReadResult& source) {
    return scaledLight(session, source.web, candelaUnit(source.format, source.facts), 1);
}

std::optional<LightFile> makeFile(const HostSession& session, const std::string& file, const TargetFormat& target,
                                  RnIntensityDist& light, OvPhotometrics::FileForm form,
                                  const std::vector<Fact>& facts, std::vector<std::string>& messages) {
    auto bytes = fileBytes(session, target, light, form, facts, messages);
    if (!bytes) return {};
    LightFile made{std::move(*bytes), {}, {}, {}};
    ReadResult again = session.readBytes(made.bytes, file, target.name);
    if (again.web) {
        made.facts = std::move(again.facts);
        // NIMB files hold candela, and so a flux, for 1000 lumens, but not of how many.
        const float thousands = again.format == "NIMB" && light.getFlux() > 0 ? light.getFlux() / 1000 : 1;
        made.light = scaledLight(session, again.web, thousands * candelaUnit(again.format, made.facts), thousands);
    } else {
        made.refusal = std::string("the output is no readable ") + target.name + " file";
        for (const std::string& reason : again.reasons()) made.refusal += ": " + reason;
    }
    return made;
}

std::vector<std::string> lossWarnings(const ConversionLoss& loss, const TargetFormat& target,
                                      const RnIntensityDist& light, const LightFile& file) {
    std::vector<std::string> warnings;
    const std::string flux = shortNumber(light.getFlux()) + " lm";
    if (target.name == std::string("NIMB"))
        warnings.push_back("NIMB holds no flux: its candela are for 1000 lm, those of the source for " + flux);
    if (loss.candelaPercent > tolerated) {
        warnings.push_back("the candela differ by up to " + shortNumber(loss.candela) + " cd, " +
                           shortNumber(loss.candelaPercent) + " % of the peak");
    }
    if (std::abs(loss.fluxPercent) > tolerated) {
        std::string text = "the flux differs by " + shortNumber(loss.fluxPercent) + " %";
        if (!target.holdsFlux)
            text += ": readers integrate " + shortNumber(file.light->getFlux()) + " lm instead of " + flux;
        warnings.push_back(text);
    }
    return warnings;
}

}  // namespace OvTool
