#include "bench/bench.h"

#include <charconv>
#include <cstdio>
#include <random>

#include "components/photo/files/webDistribution.h"
#include "components/photo/lid/component.h"
#include "components/support/devices.h"
#include "ovphoto/photoFormat.h"

namespace bench {

namespace {

std::vector<Ratio>& table() {
    static std::vector<Ratio> lines;
    return lines;
}

}  // namespace

bool addRatios(std::initializer_list<Ratio> ratios) {
    table().insert(table().end(), ratios);
    return true;
}

const std::vector<Ratio>& ratios() { return table(); }

std::string iesText(int verticalCount, int horizontalCount, bool closed) {
    std::mt19937 random(1);
    std::uniform_real_distribution<double> candela(0, 2500);
    std::string text = "IESNA:LM-63-2002\n[TEST] generated\n[MANUFAC] none\nTILT=NONE\n1 -1 1 " +
                       std::to_string(verticalCount) + " " + std::to_string(horizontalCount) +
                       " 1 2 0 0 0\n1 1 100\n";
    std::size_t lineStart = text.size();
    const auto add = [&](const char* format, double value) {
        char number[32];
        const auto length = static_cast<std::size_t>(std::snprintf(number, sizeof number, format, value));
        if (text.size() + length + 1 - lineStart > 130) {
            text += '\n';
            lineStart = text.size();
        }
        text.append(number, length) += ' ';
    };
    for (int i = 0; i < verticalCount; ++i) add("%.4g", 180.0 * i / (verticalCount - 1));
    const int gaps = closed ? horizontalCount - 1 : horizontalCount;
    for (int j = 0; j < horizontalCount; ++j) add("%.4g", 360.0 * j / gaps);
    for (int k = 0; k < verticalCount * horizontalCount; ++k) add(k % 2 ? "%.1f" : "%.2f", candela(random));
    return text;
}

Ov::RnRef<Ov::RnPhotoWebData> import(const Ov::RnUid& classId, const std::string& text) {
    return import(classId, *Ov::rnCreate<Ov::RnMemoryBuffer>(text));
}

Ov::RnRef<Ov::RnPhotoWebData> import(const Ov::RnUid& classId, Ov::RnBufferedIO& io) {
    const auto builder = Ov::rnCast<Ov::RnImportBuilder>(OvPhotometrics::builderTable().find(classId));
    io.seek(0, 0);
    const auto object = builder->import(Ov::RnPtr<Ov::RnBufferedIO>(&io), L"bench", nullptr);
    return Ov::rnCast<Ov::RnPhotoWebData>(object.get());
}

Ov::RnRef<Ov::RnPhotoWebData> webOf(int verticalCount, int horizontalCount) {
    return import(OvPhotometrics::classIds::iesWeb, iesText(verticalCount, horizontalCount, false));
}

std::string fileText(const Ov::RnUid& classId, Ov::RnPhotoWebData& web) {
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
    Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
    const auto light = OvPhotometrics::makeWebDistribution(web);
    Ov::rnCast<Ov::RnPhotoFormat>(OvPhotometrics::builderTable().find(classId))
        ->write(*light, stream, Ov::FileForm::faithful, nullptr, 0);
    return io->bytes();
}

std::vector<float> randomAngles(std::size_t count) {
    std::mt19937 random(2);
    std::uniform_real_distribution<float> theta(0, 3.1415926f), psi(0, 6.283185f);
    std::vector<float> angles;
    for (std::size_t k = 0; k < count; ++k) {
        angles.push_back(theta(random));
        angles.push_back(psi(random));
    }
    return angles;
}

void countEach(benchmark::State& state, std::size_t count) {
    using benchmark::Counter;
    state.counters["each"] =
        Counter(static_cast<double>(count), Counter::kIsIterationInvariantRate | Counter::kInvert);
}

void countBytes(benchmark::State& state, std::size_t bytes) {
    state.SetBytesProcessed(static_cast<std::int64_t>(bytes) * state.iterations());
}

float walkNumbers(const std::string& text) {
    float sum = 0;
    const char* const end = text.data() + text.size();
    for (const char* p = text.data(); p != end;) {
        float value = 0;
        const auto [behind, failure] = std::from_chars(p, end, value);
        sum += value;
        p = behind == p ? p + 1 : behind;
        while (p != end && (*p == ' ' || *p == '\n')) ++p;
    }
    return sum;
}

}  // namespace bench
