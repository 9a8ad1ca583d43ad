#include <algorithm>
#include <array>
#include <string>
#include <utility>
#include <vector>

#include "components/support/path.h"
#include "fuzz/fuzz.h"
#include "host/componentManager/stream.h"
#include "tests/support/dripDevice.h"
#include "tests/support/plainDevice.h"

// A format, a line feed, and the input that it reads: from memory, and from devices that show a byte at a time or none.

namespace OvPhotometrics::fuzz {

namespace {

constexpr std::size_t mostFields = 12;

/// What a format leaves behind: count, targets and the rest of the input.
struct Outcome {
    int count;
    std::array<std::vector<wchar_t>, mostFields> fields;
    std::string rest;

    Outcome(const Ov::RnRef<Ov::RnBufferedIO>& device, const wchar_t* format, std::size_t size) {
        fields.fill(std::vector<wchar_t>(size + 2, L'?'));  // a text may be as long as the input
        Ov::RnStream stream(device.get(), Ov::RnStream::Form::text);
        measured(size, [&] { count = read(stream, format, std::make_index_sequence<mostFields>()); });
        Ov::RnCharInput(*device).takeWhile([&](int c) { return rest += static_cast<char>(c), true; });
    }
    template <std::size_t... k>
    int read(Ov::RnStream& stream, const wchar_t* format, std::index_sequence<k...>) {
        return stream.formattedRead(format, fields[k].data()...);
    }
    bool operator==(const Outcome&) const = default;
};

}  // namespace

void tryInput(std::string_view bytes) {
    const std::size_t end = std::min(bytes.find('\n'), bytes.size());
    const std::wstring format = Ov::fromUtf8(bytes.substr(0, end));
    const std::string input(bytes.substr(std::min(end + 1, bytes.size())));
    const auto fields = std::count(format.begin(), format.end(), L'%');
    if (fields > static_cast<std::ptrdiff_t>(mostFields)) return;
    const Outcome whole(Ov::rnCreate<Ov::RnMemoryBuffer>(input), format.c_str(), input.size());
    demand(whole.count >= -1 && whole.count <= fields, "no more is counted than asked for");
    demand(input.ends_with(whole.rest), "what is not read stays");
    const Outcome drip(Ov::rnCreate<DripDevice>(input), format.c_str(), input.size());
    const Outcome plain(Ov::rnCreate<PlainDevice>(input), format.c_str(), input.size());
    demand(whole == drip && whole == plain, "every device reads the same");
}

}  // namespace OvPhotometrics::fuzz
