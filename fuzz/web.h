#pragma once

#include <algorithm>
#include <cmath>
#include <iterator>
#include <limits>
#include <string>
#include <vector>

#include "components/photo/files/fileFacts.h"
#include "components/photo/files/recognition.h"
#include "components/photo/files/webDistribution.h"
#include "components/photo/lid/photoWeb.h"
#include "components/support/devices.h"
#include "fuzz/fuzz.h"
#include "host/componentManager/componentManager.h"
#include "host/componentManager/importer.h"
#include "ovphoto/classIds.h"
#include "ovphoto/intensities.h"
#include "tests/support/plainDevice.h"

// What is demanded of the builder of a file format: any bytes are refused with a message, or give, without one, a
// web that is whole, gives light everywhere, is written in every format, and reads back. Written, it is of that format by content.

namespace OvPhotometrics::fuzz {

inline bool isFinite(float value) { return std::isfinite(value); }

inline bool isWhole(const std::vector<float>& angles) {
    return std::is_sorted(angles.begin(), angles.end()) && std::all_of(angles.begin(), angles.end(), isFinite);
}

/// The angles of a web, one axis.
template <class At>
std::vector<float> angles(int count, At at) {
    std::vector<float> all;
    for (int k = 0; k < count; ++k) all.push_back(at(k));
    return all;
}

inline void demandInstalled(const Ov::RnPhotoWebData& web) {
    const auto thetas = angles(web.getThetaCount(), [&](int i) { return web.getTheta(i); });
    const auto psis = angles(web.getPsiCount(), [&](int j) { return web.getPsi(j); });
    demand(thetas.size() >= 2 && isWhole(thetas), "vertical angles ascend");
    demand(!psis.empty() && isWhole(psis) && compareAngles(psis.front(), 0) == 0,
           "horizontal angles ascend from 0");
    const auto symmetry = web.getSymmetry();
    demand(symmetry == PhotoWebSymmetry::Axial ? psis.size() == 1
                                               : psis.size() >= 2 && compareAngles(psis.back(), 0) > 0 &&
                                                     compareAngles(psis.back(), psiExtent(symmetry)) <= 0,
           "horizontal angles fit the symmetry");

    const float peak = web.getMaxCandela();
    demand(std::isfinite(peak) && peak >= 0 && std::isfinite(web.getLumens()), "peak and flux are finite");
    float largest = -std::numeric_limits<float>::infinity();
    std::vector<float> row(thetas.size());
    for (int j = 0; j < web.getPsiCount(); ++j) {
        web.getCandelaBlock({j, j}, {0, web.getThetaCount() - 1}, row.data());
        demand(std::all_of(row.begin(), row.end(), isFinite), "values are finite");
        largest = std::max(largest, *std::max_element(row.begin(), row.end()));
    }
    demand(peak > 0 ? largest == 1 : largest <= 0 && web.getLumens() == 0, "values are relative to the peak");

    const auto m = web.getOrientation();
    const auto turnedBack = m * (m.computeTranspose() * GeVector3<float>{0.48f, 0.6f, 0.64f});
    demand(
        std::fabs(turnedBack.x - 0.48f) + std::fabs(turnedBack.y - 0.6f) + std::fabs(turnedBack.z - 0.64f) < 1e-5f,
        "the orientation is a turn");
    demand(!web.hasIdentityOrientation() || m.values() == GeLinearMatrix3<float>().values(), "no turn is none");
    demand(web.isLoaded(), "it is loaded");
}

/// Some angles of every kind, and each web's own with their neighbours.
inline std::vector<float> probes(AngleRange range) {
    constexpr float infinity = std::numeric_limits<float>::infinity();
    std::vector<float> all{0.0f, -0.0f, 1e-45f, 1e-6f, 0.3f,  1.1f,     halfPi,    2.5f,         pi,
                           4.0f, twoPi, -1.0f,  -7.0f, 1e30f, infinity, -infinity, std::nanf("")};
    for (const float angle : {range.first, range.last, (range.first + range.last) / 2, halfPi, pi, twoPi})
        for (const float towards : {-infinity, angle, infinity}) all.push_back(std::nextafter(angle, towards));
    return all;
}

inline void demandLight(const Ov::RnPhotoWebData& web, Ov::RnIntensityDist& light) {
    std::vector<float> angles, vectors;
    for (const float theta : probes(web.getThetaRange()))
        for (const float psi : probes(web.getPsiRange())) {
            angles.insert(angles.end(), {theta, psi});
            vectors.insert(vectors.end(), {theta, psi, 1 - theta});
        }
    // One by one and all at once.
    const auto demandAll = [&](DirectionForm form, const std::vector<float>& directions, auto candela) {
        const std::size_t count = angles.size() / 2, floats = directions.size() / count;
        std::vector<float> together(count);
        demand(getIntensities(&light, form, directions.data(), static_cast<std::int64_t>(count), together.data()),
               "many directions are answered");
        for (std::size_t k = 0; k < count; ++k) {
            const float alone = candela(&directions[k * floats]);
            demand(std::isfinite(alone) && alone >= 0, "light is finite");
            demand(alone == together[k], "many directions are answered as one is");
        }
    };
    demandAll(DirectionForm::localAngles, angles,
              [&](const float* d) { return light.localIntensity(d[0], d[1]); });
    demandAll(DirectionForm::angles, angles, [&](const float* d) { return light.intensity(d[0], d[1]); });
    demandAll(DirectionForm::vectors, vectors, [&](const float* d) {
        return light.intensityAt({d[0], d[1], d[2]});
    });
    demandAll(DirectionForm::localVectors, vectors, [&](const float* d) {
        return light.localIntensityAt({d[0], d[1], d[2]});
    });
}

/// The formats of all builders, in the order in which an importer asks them.
inline const std::vector<RnRef<Ov::RnPhotoFormat>>& formats() {
    static const auto all = [] {
        std::vector<RnRef<Ov::RnPhotoFormat>> found;
        auto visitor =
            Ov::rnVisitor<Ov::RnCPtr<Ov::RnImportBuilder>>([&](Ov::RnCPtr<Ov::RnImportBuilder> builder) {
                found.push_back(Ov::rnCast<Ov::RnPhotoFormat>(const_cast<Ov::RnImportBuilder*>(builder.get())));
            });
        const auto manager = Ov::rnCast<Ov::RnComponentManager>(Ov::RnGetComponentManager());
        const auto importer = manager->createObject(classIds::importer);
        Ov::rnCast<Ov::RnImporter>(importer.get())->enumerateObjects(visitor);
        return found;
    }();
    return all;
}

/// The web that a format's builder imports, checked; null when it is refused.
inline RnRef<Ov::RnPhotoWebData> imported(Ov::RnPhotoFormat& format, Ov::RnBufferedIO& io, std::size_t size) {
    RnRef<Ov::RnCastable> object;
    measured(size, [&] {
        try {
            object = format.import(Ov::RnPtr<Ov::RnBufferedIO>(&io), L"web", nullptr);
        } catch (const Ov::RnStreamEx::ExReadError&) {
        }
    });
    demand((takeMessages() == 0) == !!object, "what is refused has a message, and nothing else has");
    if (!object) return {};
    auto web = Ov::rnCast<Ov::RnPhotoWebData>(object.get());
    demandInstalled(*web);
    demandLight(*web, *makeWebDistribution(*web));
    return web;
}

/// The format that an input is taken for; null when there is none.
inline Ov::RnPhotoFormat* recognisedFormat(Ov::RnBufferedIO& io) {
    const Ov::RnUid id = recognisedClass(io);
    for (const auto& format : formats())
        if (Ov::rnCast<Ov::RnComponentBuilder>(format.get())->getClassId() == id) return format.get();
    return nullptr;
}

/// Writes a web as a file for other programs, with the facts of the file that it came from, and reads that.
inline void demandWritten(Ov::RnPhotoFormat& format, Ov::RnPhotoWebData& web, const FileFacts& facts) {
    const std::vector<FileFact> given = facts.list();
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>();
    Ov::RnStream stream(io.get(), Ov::RnStream::Form::text);
    const bool written = format.write(*makeWebDistribution(web), stream, FileForm::faithful, given.data(),
                                      static_cast<std::int32_t>(given.size()));
    // What is written may have them, too: of texts that stand behind a blank.
    demand(takeMessages() > 0 || written, "what is not written has a message");
    const auto ordinary = [](float value) {
        return value == 0 || (std::fabs(value) > 1e-20f && std::fabs(value) < 1e20f);
    };
    demand(written || !ordinary(web.getMaxCandela()) || !ordinary(web.getLumens()), "what is read is written");
    if (!written) return;
    io->seek(0, 0);
    demand(recognisedFormat(*io) == &format, "what is written is recognised as its format");
    demand(!!imported(format, *io, io->bytes().size()), "what is written is read");
}

/// Tries bytes as a file of a format.
inline void tryFile(Ov::RnPhotoFormat& format, std::string_view bytes) {
    const auto io = Ov::rnCreate<Ov::RnMemoryBuffer>(bytes);
    format.canImport(static_cast<Ov::RnBufferedIO*>(io.get()));
    demand(io->seek(0, 1) == 0 && takeMessages() == 0, "the content test leaves no trace");
    const auto web = imported(format, *io, bytes.size());
    const auto plain = Ov::rnCreate<PlainDevice>(bytes);
    demand(!!imported(format, *plain, bytes.size()) == !!web && plain->seek(0, 1) == io->seek(0, 1),
           "every device is read the same");
    if (!web) return;
    const auto facts = [&] {
        FileFacts all;
        auto visitor = Ov::rnVisitor<const FileFact&>(
            [&](const FileFact& fact) { all.add(fact.key, std::wstring(fact.text), fact.kind); });
        io->seek(0, 0);
        demand(format.readFacts(*io, nullptr, visitor), "what is read has facts");
        return all;
    };
    const auto values =
        static_cast<std::size_t>(web->getThetaCount()) * static_cast<std::size_t>(web->getPsiCount());
    std::size_t part = 0;
    for (const auto& target : formats())
        if (target->getTraits().writes && isDue(bytes, part++, values)) demandWritten(*target, *web, facts());
}

}  // namespace OvPhotometrics::fuzz
