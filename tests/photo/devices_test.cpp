#include <algorithm>
#include <filesystem>
#include <fstream>
#include <iterator>

#include "components/photo/distributions/diffuse.h"
#include "components/photo/distributions/isotropic.h"
#include "components/photo/distributions/spotlight.h"
#include "components/photo/naturallight/daylightData.h"
#include "tests/photo/photoFixture.h"
#include "tests/support/dripDevice.h"
#include "tests/support/paths.h"
#include "tests/support/plainDevice.h"

// What devices of hosts are read and written as memory is: all forms of files and streams, with the same objects,
// messages and positions.

namespace OvPhotometrics {
namespace {

using Device = RnRef<Ov::RnBufferedIO>;

Device memory(std::string_view bytes) { return Ov::rnCreate<Ov::RnMemoryBuffer>(bytes); }

template <class Tested>
class Devices : public Photo {
protected:
    using MakeDevice = Device (*)(std::string_view bytes);

    static Device tested(std::string_view bytes) { return Ov::rnCreate<Tested>(std::string(bytes)); }

    Devices() {
        const auto web = import(IesText{.horizontal = {0, 45, 90, 135, 180}}.text());
        sources = {web,
                   distributionOf(*web),
                   Ov::rnCreate<Isotropic>(),
                   Ov::rnCreate<Diffuse>(),
                   Ov::rnCreate<Spotlight>(),
                   Ov::rnCreate<DaylightData>()};
        for (const auto& [id, builder] : builderTable())
            if (const auto format = Ov::rnQuery<Ov::RnPhotoFormat>(builder)) {
                const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(fileOf(*format, *distributionOf(*web)));
                sources.push_back(format->import(Ov::RnPtr<Ov::RnBufferedIO>(io.get()), L"", nullptr));
            }
    }

    /// Everything that a device holds.
    static std::string all(const Device& device) {
        device->seek(0, 0);
        std::string bytes;
        Ov::RnCharInput(*device).takeWhile([&](int c) { return bytes += static_cast<char>(c), true; });
        return bytes;
    }

    /// What `read` answers over a device with these bytes, the messages, where it stops, and the characters there.
    template <class Read>
    std::string outcome(MakeDevice make, const std::string& bytes, const Read& read) {
        const Device device = make(bytes);
        std::string result;
        try {
            result = read(*device);
        } catch (const Ov::ExBase& failure) {
            result = failure.getDetailedReason();
        }
        Ov::RnCharInput rest(*device);
        result += "\n" + log.take() + " at " + std::to_string(device->seek(0, 1)) + " before";
        for (int k = 0; k < 3; ++k) result += " " + std::to_string(rest.getChar());
        return result;
    }

    /// An object saved over a device in both forms.
    std::string savedIn(MakeDevice make, Ov::RnCastable& object) {
        std::string both;
        for (const Form form : {Form::text, Form::binary}) {
            const Device device = make({});
            Ov::RnStream(device.get(), form) << 7 << &object << std::wstring(L"end");
            both += all(device);
        }
        return both;
    }

    /// Each way to read these bytes gives over the device what it gives over memory.
    void readsAsMemory(const std::string& bytes) {
        const auto same = [&](const char* what, const auto& read) {
            const std::string expected = outcome(memory, bytes, [&](auto& io) { return read(io, memory); });
            const auto actual = [&](auto& io) { return read(io, tested); };
            EXPECT_EQ(outcome(tested, bytes, actual), expected) << what << ": " << bytes.substr(0, 200);
        };
        for (const auto& [id, builder] : builderTable()) {
            const auto importer = Ov::rnQuery<Ov::RnPhotoFormat>(builder);
            if (!importer) continue;
            same("recognised", [&](auto& io, auto) { return importer->canImport(&io) ? "yes" : "no"; });
            same("imported", [&](auto& io, MakeDevice make) {
                return savedIn(make, *importer->import(Ov::RnPtr<Ov::RnBufferedIO>(&io), L"web", L""));
            });
            same("facts", [&](auto& io, auto) {
                std::wstring all;
                auto visitor = Ov::rnVisitor<const FileFact&>(
                    [&](const FileFact& fact) { all += fact.key + std::wstring(fact.text); });
                importer->readFacts(io, L"", visitor);
                return Ov::toUtf8(all);
            });
        }
        for (const Form form : {Form::text, Form::binary}) {
            same("natural light", [&](auto& io, MakeDevice make) {
                const auto light = Ov::rnCreate<DaylightData>();
                Ov::RnStream stream(&io, form);
                const bool loaded = Ov::rnCast<Ov::RnPersistant>(light.get())->load(stream, 0, nullptr, nullptr);
                return (loaded ? "loaded " : "refused ") + savedIn(make, *light);
            });
            same("object", [&](auto& io, MakeDevice make) {
                Ov::RnStream stream(&io, form);
                int before = 0;
                std::wstring after;
                stream >> before;
                const auto object = stream.readObject(nullptr);
                stream >> after;
                return savedIn(make, *object) + Ov::toUtf8(after);
            });
        }
    }

    std::vector<RnRef<Ov::RnCastable>> sources;
};

using Kinds = testing::Types<PlainDevice, DripDevice>;
TYPED_TEST_SUITE(Devices, Kinds);

TYPED_TEST(Devices, AreReadAndWrittenAsMemoryIs) {
    for (const auto& object : this->sources) {
        const std::string saved = this->savedIn(memory, *object);
        EXPECT_EQ(this->savedIn(this->tested, *object), saved);
        for (const auto form : {Ov::RnStream::Form::text, Ov::RnStream::Form::binary}) {
            const Device device = memory({});
            Ov::RnStream(device.get(), form) << 7 << object.get() << std::wstring(L"end");
            const std::string bytes = this->all(device);
            int before = 0;
            device->seek(0, 0);
            Ov::RnStream again(device.get(), form);
            again >> before;
            const auto same = again.readObject(nullptr);
            const bool isWeb = !!Ov::rnQuery<Ov::RnPhotoWebData>(same.get());  // which keeps no candela
            EXPECT_TRUE(isWeb || this->savedIn(memory, *same) == saved);
            for (std::size_t size = bytes.size(); size > 0; size -= 1 + size / 20)
                this->readsAsMemory(bytes.substr(0, size));
        }
    }
    for (const char* folder : {"/tests/data", "/examples"})
        for (const auto& entry : std::filesystem::recursive_directory_iterator(sourceFolder() + folder)) {
            if (!entry.is_regular_file()) continue;
            std::ifstream file(entry.path(), std::ios::binary);
            const std::string bytes{std::istreambuf_iterator<char>(file), {}};
            for (const std::string& each : {bytes, withLineEnds(bytes, "\r"), withLineEnds(bytes, "\r\n"),
                                            bytes.substr(0, bytes.size() / 2)})
                this->readsAsMemory(each);
        }
}

}  // namespace
}  // namespace OvPhotometrics
