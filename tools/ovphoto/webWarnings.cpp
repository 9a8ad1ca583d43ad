#include "tools/ovphoto/webWarnings.h"

#include <algorithm>
#include <optional>

#include "components/support/path.h"
#include "tools/numbers/numbers.h"
#include "tools/ovphoto/fileAngles.h"

namespace OvTool {

using namespace Ov;

namespace {

constexpr float tolerance = 0.25F;  // degrees: nearer angles count as the same

std::optional<std::string> negativeValues(const RnPhotoWebData& web) {
    const int psis = web.getPsiCount();
    const int thetas = web.getThetaCount();
    int negative = 0;
    for (int j = 0; j < psis; ++j) {
        for (int i = 0; i < thetas; ++i) negative += web.getCandela(j, i) < 0;
    }
    if (negative == 0) return {};
    return std::to_string(negative) + (negative == 1 ? " candela value is" : " candela values are") + " negative";
}

/// The factor of a file, if any, that makes all of its values 0.
std::string zeroFactor(const std::vector<Fact>& facts) {
    static constexpr std::pair<const wchar_t*, const char*> names[] = {
        {L"multiplier", "candela multiplier"},
        {L"ballastFactor", "ballast factor"},
        {L"ballastLampFactor", "ballast-lamp factor (future use)"}};
    const auto zero = std::find_if(facts.begin(), facts.end(), [](const Fact& fact) {
        return fact.kind == FactKind::factor && parseFloat(toUtf8(fact.text)) == 0.0F;
    });
    if (zero == facts.end()) return {};
    for (const auto& [key, name] : names)
        if (zero->key == key) return name;
    return toUtf8(zero->key);
}

std::optional<std::string> darkness(const ReadResult& result) {
    if (result.web->getMaxCandela() > 0) return {};
    const std::string factor = zeroFactor(result.facts);
    if (!factor.empty()) return "all values are 0, because the " + factor + " is 0";
    return "no value is above 0: the light is dark";
}

bool hasTilt(const std::vector<Fact>& facts) {
    const std::wstring* tilt = findFact(facts, L"tilt");
    return tilt && *tilt != L"NONE";
}

bool isTypeB(const std::vector<Fact>& facts) {
    const std::wstring* type = findFact(facts, L"photometricType");
    return type && *type == L"B";
}

/// Whether a type B file lies as its angles do, its axis not laid down: its horizontal angles start at 0.
bool isUnturnedTypeB(const ReadResult& file) {
    return isTypeB(file.facts) && file.web->hasIdentityOrientation() &&
           file.web->getSymmetry() == PhotoWebSymmetry::Half;
}

/// How far the light's last plane lies from where the symmetry wants it, beyond what a step may be.
std::optional<std::string> earlyEnd(RnPhotoWebData& web) {
    const int count = web.getPsiCount();
    if (web.isPsiTruncated() || web.getSymmetry() == PhotoWebSymmetry::Axial || count < 2) return {};
    const double last = toDegrees(web.getPsi(count - 1));
    const float end = web.getSymmetry() == PhotoWebSymmetry::Full   ? 360
                      : web.getSymmetry() == PhotoWebSymmetry::Half ? 180
                                                                    : 90;
    double allowed = tolerance;
    if (web.getSymmetry() == PhotoWebSymmetry::Full) {
        double step = 0;
        for (int j = 1; j < count; ++j)
            step = std::max(step, toDegrees(web.getPsi(j)) - toDegrees(web.getPsi(j - 1)));
        allowed = 1.5 * step;
    }
    if (end - last <= allowed) return {};
    const PhotoFileInfo file = fileInfoOf(web);
    return "the horizontal angles end at " + shortNumber(horizontalOf(file, web.getPsi(count - 1))) +
           " deg: up to " + shortNumber(horizontalOf(file, toRadians(end))) + " deg the values are extrapolated";
}

}  // namespace

std::optional<std::string> negativeFlux(RnPhotoWebData& web) {
    const float lumens = luminaireLumensOf(web);
    if (!(lumens < 0)) return {};
    return "the flux of the luminaire is negative: the values integrate to " + shortNumber(lumens) + " lm";
}

std::optional<std::string> lostTypeB(const ReadResult& source, const std::vector<Fact>& output) {
    if (!isUnturnedTypeB(source) || isTypeB(output)) return {};
    return "type B with horizontal angles from 0 is written as it lies here, its axis at the host's +X: other "
           "programs that read the source lay it down";
}

std::vector<std::string> webWarnings(const ReadResult& result) {
    std::vector<std::string> warnings;
    const auto add = [&warnings](std::optional<std::string> warning) {
        if (warning) warnings.push_back(std::move(*warning));
    };
    add(negativeValues(*result.web));
    add(negativeFlux(*result.web));
    add(darkness(result));
    if (hasTilt(result.facts)) add("the tilt data is read but not applied");
    if (isUnturnedTypeB(result))
        add("type B with horizontal angles from 0 stays unturned: its axis lies at the host's +X, not at -Y");
    add(earlyEnd(*result.web));
    return warnings;
}

}  // namespace OvTool
