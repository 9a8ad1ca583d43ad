#include "tools/ovphoto/webWarnings.h"

#include <algorithm>
#include <fstream>
#include <iterator>
#include <numbers>
#include <optional>

#include "host/platform/path.h"
#include "tools/ovphoto/iesFacts.h"
#include "tools/ovphoto/numbers.h"

namespace OvTool {

using namespace Ov;

namespace {

constexpr float tolerance = 0.25F;  // degrees: nearer angles count as the same

std::optional<IesFacts> factsOf(const ReadResult& result) {
    if (result.format != "IES") return {};
    std::ifstream file(nativePath(fromUtf8(result.file)), std::ios::binary);
    const std::string bytes(std::istreambuf_iterator<char>(file), {});
    return readIesFacts(bytes);
}

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

const char* zeroFactor(const IesFacts& facts) {
    if (facts.candelaMultiplier == 0) return "candela multiplier";
    if (facts.ballastFactor == 0) return "ballast factor";
    if (facts.ballastLampFactor == 0) return "ballast-lamp factor (future use)";
    return nullptr;
}

std::optional<std::string> darkness(const RnPhotoWebData& web, const std::optional<IesFacts>& facts) {
    if (web.getMaxCandela() > 0) return {};
    const char* factor = facts ? zeroFactor(*facts) : nullptr;
    if (factor) return std::string("all values are 0, because the ") + factor + " is 0";
    return "no value is above 0: the light is dark";
}

/// How far the light's last plane lies from where the symmetry wants it, beyond what a step may be.
std::optional<std::string> earlyEnd(const RnPhotoWebData& web) {
    const int count = web.getPsiCount();
    if (web.isPsiTruncated() || web.getSymmetry() == PhotoWebSymmetry::Axial || count < 2) return {};
    const float last = toDegrees(web.getPsi(count - 1));
    const float end = web.getSymmetry() == PhotoWebSymmetry::Full   ? 360
                      : web.getSymmetry() == PhotoWebSymmetry::Half ? 180
                                                                    : 90;
    float allowed = tolerance;
    if (web.getSymmetry() == PhotoWebSymmetry::Full) {
        float step = 0;
        for (int j = 1; j < count; ++j)
            step = std::max(step, toDegrees(web.getPsi(j)) - toDegrees(web.getPsi(j - 1)));
        allowed = 1.5F * step;
    }
    if (end - last <= allowed) return {};
    return "the horizontal angles end at " + shortNumber(last) + " deg: up to " + shortNumber(end) +
           " deg the values are extrapolated";
}

}  // namespace

std::vector<std::string> webWarnings(const ReadResult& result) {
    std::vector<std::string> warnings;
    const auto add = [&warnings](std::optional<std::string> warning) {
        if (warning) warnings.push_back(std::move(*warning));
    };
    const std::optional<IesFacts> facts = factsOf(result);
    add(negativeValues(*result.web));
    add(darkness(*result.web, facts));
    if (facts && facts->hasTilt) add("the tilt data is read but not applied");
    if (facts && facts->photometricType == 2 && facts->firstHorizontalAngle > -tolerance) {
        add("type B with horizontal angles from 0 stays unturned: its axis lies at the host's +X, not at -Y");
    }
    add(earlyEnd(*result.web));
    return warnings;
}

}  // namespace OvTool
