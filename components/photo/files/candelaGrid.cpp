#include "components/photo/files/candelaGrid.h"

#include <algorithm>
#include <limits>
#include <new>
#include <stdexcept>

#include "components/messageFile/messageIds.h"
#include "components/photo/lid/reportMessage.h"

namespace OvPhotometrics {

namespace {

std::size_t product(int verticalCount, int horizontalCount) {
    return static_cast<std::size_t>(verticalCount) * static_cast<std::size_t>(horizontalCount);
}

std::vector<float> evenAngles(int count, double last) {
    std::vector<float> angles(static_cast<std::size_t>(count));
    for (int i = 1; i < count; ++i)
        angles[static_cast<std::size_t>(i)] = static_cast<float>(i * last / (count - 1));
    return angles;
}

bool readGroup(NumberText& in, int count, std::vector<float>& values, Ov::Message<> failure) {
    if (in.readFloats(static_cast<std::size_t>(count), values)) return true;
    reportParseMessage(failure);
    return false;
}

constexpr int samplingStep = 10;  // degrees

int sampledPlanes(PhotoWebSymmetry symmetry, LastPlane lastPlane) {
    if (symmetry == PhotoWebSymmetry::Axial) return 1;
    const bool closes = symmetry == PhotoWebSymmetry::Full;  // its last plane is the first
    return psiExtentInDegrees(symmetry) / samplingStep + (lastPlane == LastPlane::with && !closes ? 1 : 0);
}

}  // namespace

bool candelaGridAlloc(CandelaGrid& grid, int verticalCount, int horizontalCount) {
    try {
        CandelaGrid even;
        even.verticalCount = std::max(verticalCount, 2);
        even.horizontalCount = std::max(horizontalCount, 1);
        even.candelas.resize(product(even.verticalCount, even.horizontalCount));
        even.verticalAngles = evenAngles(even.verticalCount, 180);
        even.horizontalAngles = evenAngles(even.horizontalCount, 360);
        grid = std::move(even);
        return true;
    } catch (const std::bad_alloc&) {
    } catch (const std::length_error&) {
    }
    reportMessage(messages::outOfMemory);
    return false;
}

bool candelaGridReadCounts(CandelaGrid& grid, NumberText& in) {
    return in.readInteger(grid.verticalCount, messages::verticalCount, 2) &&
           in.readInteger(grid.horizontalCount, messages::horizontalCount, 1);
}

bool candelaGridRead(CandelaGrid& grid, NumberText& in) {
    const std::size_t candelas = product(grid.verticalCount, grid.horizontalCount);
    if (candelas <= std::numeric_limits<std::int32_t>::max()) {
        try {
            return readGroup(in, grid.verticalCount, grid.verticalAngles, messages::verticalAngle) &&
                   readGroup(in, grid.horizontalCount, grid.horizontalAngles, messages::horizontalAngle) &&
                   readGroup(in, static_cast<int>(candelas), grid.candelas, messages::candela);
        } catch (const std::bad_alloc&) {
        }
    }
    reportParseMessage(messages::outOfMemory);
    return false;
}

void candelaGridWrite(const CandelaGrid& grid, Ov::RnStream& out, int limit, FileForm form) {
    writeValueList(grid.verticalAngles.size(), grid.verticalAngles.data(), out, limit, form);
    writeValueList(grid.horizontalAngles.size(), grid.horizontalAngles.data(), out, limit, form);
    const auto row = static_cast<std::size_t>(grid.verticalCount);
    for (int j = 0; j < grid.horizontalCount; ++j)
        writeValueList(row, &grid.candelas[grid.index(0, j)], out, limit, form);
}

GridFit gridFit(const Ov::RnPhotoWebData& web) {
    const auto about = [](float a, float b) { return compareAngles(a, b) == 0; };
    const AngleRange theta = web.getThetaRange();
    const AngleRange psi = web.getPsiRange();
    const bool polarThetas = (about(theta.first, 0) || about(theta.first, halfPi)) &&
                             (about(theta.last, halfPi) || about(theta.last, pi));
    const bool polarPsis =
        about(psi.first, 0) && (about(psi.last, 0) || about(psi.last, halfPi) || compareAngles(psi.last, pi) >= 0);
    if (polarThetas && polarPsis) return GridFit::polar;
    if (web.getSymmetry() == PhotoWebSymmetry::Half && compareAngles(psi.last, halfPi) <= 0)
        return GridFit::lateral;
    if (web.getSymmetry() == PhotoWebSymmetry::Full && compareAngles(psi.last, pi) <= 0) return GridFit::lateral;
    return GridFit::none;
}

bool candelaGridFromWeb(CandelaGrid& grid, const Ov::RnPhotoWebData& web, GridFit fit, float factor) {
    const int nthetas = web.getThetaCount();
    if (!candelaGridAlloc(grid, nthetas, web.getPsiCount())) return false;
    const bool centred = fit == GridFit::lateral && web.getSymmetry() == PhotoWebSymmetry::Full;
    const double middle = centred ? inDegrees(web.getPsiRange().last) * 0.5 : 0;
    for (int i = 0; i < nthetas; ++i)
        grid.verticalAngles[static_cast<std::size_t>(i)] = static_cast<float>(inDegrees(web.getTheta(i)));
    for (int j = 0; j < web.getPsiCount(); ++j) {
        grid.horizontalAngles[static_cast<std::size_t>(j)] = static_cast<float>(inDegrees(web.getPsi(j)) - middle);
        for (int i = 0; i < nthetas; ++i) grid.candela(i, j) = web.getCandela(j, i) * factor;
    }
    return true;
}

bool candelaGridFromSampling(CandelaGrid& grid, const Ov::RnIntensityDist& dist, LastPlane lastPlane,
                             float factor) {
    if (!candelaGridAlloc(grid, 180 / samplingStep + 1, sampledPlanes(dist.getSymmetry(), lastPlane)))
        return false;
    for (int j = 0; j < grid.horizontalCount; ++j) {
        grid.horizontalAngles[static_cast<std::size_t>(j)] = static_cast<float>(samplingStep * j);
        for (int i = 0; i < grid.verticalCount; ++i)
            grid.candela(i, j) =
                dist.localIntensity(toRadians(samplingStep * i), toRadians(samplingStep * j)) * factor;
    }
    return true;
}

}  // namespace OvPhotometrics
