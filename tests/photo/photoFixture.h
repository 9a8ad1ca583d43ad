#pragma once

#include <gtest/gtest.h>

#include <memory>
#include <span>
#include <sstream>
#include <string>

#include "components/module/registration.h"
#include "components/photo/ies/photoWebIES.h"
#include "components/photo/lid/component.h"
#include "components/support/devices.h"
#include "host/componentManager/componentManager.h"
#include "tests/support/messageLog.h"

namespace OvPhotometrics {

/// A host that knows the library's builders and logs what they report.
class Photo : public testing::Test {
protected:
    using Form = Ov::RnStream::Form;

    Photo() {
        registerBuilders();
        Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager())->addRegistry(lidComponent());
    }

    /// Imports text through a format's builder; null when it is refused.
    template <class Format = IesFormat>
    RnRef<typename Format::Web> import(const std::string& text, const wchar_t* name = L"",
                                       const wchar_t* basePath = nullptr) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(text);
        try {
            const auto object =
                immortal<PhotoWebBuilder<Format>>().import(Ov::RnPtr<Ov::RnBufferedIO>(io.get()), name, basePath);
            return RnRef<typename Format::Web>::share(dynamic_cast<typename Format::Web*>(object.get()));
        } catch (const Ov::RnStreamEx::ExReadError&) {
            return {};
        }
    }

    /// What an object's adapter saves.
    static std::string saved(Ov::RnCastable& object, Form form = Form::text) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), form);
        Ov::rnCast<Ov::RnPersistant>(&object)->save(stream);
        return io->bytes();
    }

    /// Loads an object from what its adapter may have saved.
    static bool load(Ov::RnCastable& object, const std::string& bytes, Form form = Form::text,
                     const wchar_t* name = nullptr) {
        Ov::RnStream stream(Ov::rnCreate<Ov::RnMemoryBuffer>(bytes).get(), form);
        return Ov::rnCast<Ov::RnPersistant>(&object)->load(stream, 0, name, nullptr);
    }

    /// The file that a format writes of a light; empty when it is refused.
    static std::string fileOf(Ov::RnPhotoFormat& format, Ov::RnIntensityDist& light, const FileFacts& facts = {},
                              FileForm form = FileForm::faithful) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), Form::text);
        const std::vector<FileFact> given = facts.list();
        const bool well = format.write(light, stream, form, given.data(), static_cast<std::int32_t>(given.size()));
        EXPECT_EQ(well, !io->bytes().empty());
        return io->bytes();
    }

    RnRef<Ov::RnWebIntensityDist> distributionOf(Ov::RnPhotoWebData& web) { return makeWebDistribution(web); }

    MessageLog log;
};

/// Tests of one format.
template <class Format>
class FormatTest : public Photo {
protected:
    using Record = typename Format::Record;

    struct Refusal {
        std::string text, messages;
        const char* reason = "";
    };

    RnRef<typename Format::Web> imported(const std::string& text) { return import <Format>(text); }

    /// Reads a text into `rec`.
    bool read(const std::string& text) {
        Ov::RnStream stream(Ov::rnCreate<Ov::RnMemoryBuffer>(text).get(), Form::text);
        return readRecord<Format>(rec, stream, nullptr);
    }

    /// The text of a record; empty when it is refused.
    static std::string written(const Record& record) {
        const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
        Ov::RnStream stream(io.get(), Form::text);
        return writeRecord<Format>(record, stream, FileForm::asSaved) ? io->bytes() : "";
    }

    /// Each text is refused with its messages, and a web that was to load it stays as it was.
    void refuses(const std::string& good, std::span<const Refusal> cases) {
        const auto web = import <Format>(good, L"good");
        ASSERT_TRUE(web) << log.take();
        const std::string before = saved(*web);
        for (const auto& [text, messages, reason] : cases) {
            SCOPED_TRACE(reason + (": " + text));
            EXPECT_THROW(load(*web, text, Form::text, L"bad"), Ov::RnStreamEx::ExReadError);
            EXPECT_EQ(log.take(), messages);
            EXPECT_EQ(saved(*web), before);
            EXPECT_STREQ(web->getName(), L"good");
        }
    }

    /// The content test gives one answer for these texts, and keeps the position.
    void contentTestIs(bool accepted, std::initializer_list<std::string> texts) {
        auto& builder = immortal<PhotoWebBuilder<Format>>();
        for (const std::string& text : texts) {
            const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>("??" + text);
            io->seek(2, 0);
            EXPECT_EQ(builder.canImport(static_cast<Ov::RnBufferedIO*>(io.get())), accepted) << text;
            EXPECT_EQ(io->seek(0, 1), 2);
        }
        EXPECT_THROW(builder.canImport(static_cast<Ov::RnBufferedIO*>(nullptr)), Ov::ExBadCast);
    }

    Record rec;
};

/// Numbers in text, one blank between them.
inline std::string joined(const std::vector<double>& values) {
    std::string text;
    for (const double value : values) {
        char buffer[32];
        std::snprintf(buffer, sizeof buffer, "%.9g ", value);
        text += buffer;
    }
    return text;
}

/// A text with other ends of its lines.
inline std::string withLineEnds(const std::string& text, const char* end) {
    std::string other;
    for (const char c : text) c == '\n' ? other += end : other += c;
    return other;
}

inline std::size_t longestLine(const std::string& text) {
    std::size_t longest = 0;
    std::istringstream lines(text);
    for (std::string line; std::getline(lines, line);) longest = std::max(longest, line.size());
    return longest;
}

/// Candela i + 10 j + 1 for vertical index i and horizontal index j.
inline std::string plainValues(std::size_t verticals, std::size_t horizontals) {
    std::string all;
    for (std::size_t j = 0; j < horizontals; ++j)
        for (std::size_t i = 0; i < verticals; ++i) all += std::to_string(i + 10 * j + 1) + " ";
    return all;
}

/// The text of an IES file; a test sets what is odd about it and nothing else.
struct IesText {
    std::string header = "IESNA91\n[TEST] 1\n";
    std::string tilt = "NONE\n";
    int type = 1;
    double lumens = 1000;
    std::vector<double> vertical = {0, 90, 180};
    std::vector<double> horizontal = {0};
    std::string values = {};  // empty: plain values

    std::string text() const {
        std::string all = header + "TILT=" + tilt + "1 " + joined({lumens}) + "1 " +
                          std::to_string(vertical.size()) + " " + std::to_string(horizontal.size()) + " " +
                          std::to_string(type) + " 2 0 0 0\n1 1 60\n" + joined(vertical) + "\n" +
                          joined(horizontal) + "\n";
        return all + (values.empty() ? plainValues(vertical.size(), horizontal.size()) : values);
    }
};

/// The text of a CIBSE file whose candela are twice the values.
inline std::string cibseText(int type, const std::vector<double>& vertical, const std::vector<double>& horizontal,
                             const std::string& values = "") {
    const std::string counts = std::to_string(vertical.size()) + "," + std::to_string(horizontal.size());
    return "CIBSE/1 and more\nMaker\n\n\n\n\n\n\n1 " + std::to_string(type) + " 0 0 0\n2 0 0\n0\n" + counts +
           "\r\n" + joined(vertical) + joined(horizontal) +
           (values.empty() ? plainValues(vertical.size(), horizontal.size()) : values) + "99 0 0 0";
}

/// A direction by angles in degrees.
inline GeVector3<float> direction(double theta, double psi) {
    const double t = inRadians(theta);
    const double p = inRadians(psi);
    return {static_cast<float>(std::sin(t) * std::cos(p)), static_cast<float>(std::sin(t) * std::sin(p)),
            static_cast<float>(std::cos(t))};
}

}  // namespace OvPhotometrics
