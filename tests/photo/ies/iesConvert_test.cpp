#include <cmath>

#include "tests/photo/photoFixture.h"

// From a file's angles to a web: symmetry, offsets, orientation and where the light lies.

namespace OvPhotometrics {
namespace {

class IesConvert : public Photo {};

IesText angles(int type, std::vector<double> vertical, std::vector<double> horizontal) {
    return {.type = type, .vertical = std::move(vertical), .horizontal = std::move(horizontal)};
}

TEST_F(IesConvert, AnglesChooseTheLayout) {
    using enum PhotoWebSymmetry;
    const struct {
        const char* name;
        IesText file;
        PhotoWebSymmetry symmetry;
        int psis;
        double lastPsi, firstTheta;  // degrees
        bool truncated, turned;
    } cases[] = {
        {"one plane", {.horizontal = {0}}, Axial, 1, 0, 0, false, false},
        {"planes 0 and 360", {.horizontal = {0, 360}}, Axial, 1, 0, 0, false, false},
        {"quarter", {.horizontal = {0, 45, 90}}, Quarter, 3, 90, 0, false, false},
        {"half", {.horizontal = {0, 90, 180}}, Half, 3, 180, 0, false, false},
        {"closed circle", {.horizontal = {0, 90, 180, 270, 360}}, Full, 4, 270, 0, false, false},
        {"open circle", {.horizontal = {0, 90, 180, 270}}, Full, 4, 270, 0, false, false},
        {"planes 90 to 270", {.horizontal = {90, 180, 270}}, Half, 3, 180, 0, false, true},
        {"within the tolerance", angles(1, {90.2, 179.8}, {0.2, 89.8}), Quarter, 2, 89.8, 90.2, false, false},
        {"at the tolerance", angles(1, {0, 89.75}, {0, 89.75}), Quarter, 2, 89.75, 0, false, false},
        {"closed at the tolerance", {.horizontal = {0, 90, 180, 270, 360.25}}, Full, 4, 270, 0, false, false},
        {"type A, at the tolerance", angles(3, {-90, 90}, {-90.25, 0, 90}), Full, 3, 180.25, 0, true, true},
        {"type B, one side", angles(2, {-90, 0, 90}, {0, 45, 90}), Half, 3, 90, 0, true, false},
        {"type B, both sides", angles(2, {-90, 0, 90}, {-90, 0, 90}), Full, 3, 180, 0, true, true},
        {"type A, 0 to 180", angles(3, {0, 90, 180}, {-60, 0, 60}), Full, 3, 120, 0, true, true},
        {"type A, part", angles(3, {-40, 50}, {-30, 10}), Full, 2, 40, 50, true, true},
    };
    for (const auto& c : cases) {
        SCOPED_TRACE(c.name);
        const auto web = import(c.file.text());
        ASSERT_TRUE(web) << log.take();
        EXPECT_EQ(web->getSymmetry(), c.symmetry);
        EXPECT_EQ(web->getPsiCount(), c.psis);
        EXPECT_FLOAT_EQ(web->getPsiRange().last, toRadians(c.lastPsi));
        EXPECT_FLOAT_EQ(web->getThetaRange().first, toRadians(c.firstTheta));
        EXPECT_EQ(web->isPsiTruncated(), c.truncated);
        EXPECT_EQ(web->hasIdentityOrientation(), !c.turned);
    }
}

TEST_F(IesConvert, LateralFilesAreLitWhereTheirAnglesSay) {
    IesText typeA = angles(3, {-90, 0, 90}, {-60, 0, 60}), typeB = angles(2, {-90, 0, 90}, {-80, 0, 80});
    typeA.values = "0 2 0 0 5 0 0 3 0";
    typeB.values = "0 1 0 0 9 0 0 1 0";  // its axis lies at -Y
    const auto a = distributionOf(*import(typeA.text())), b = distributionOf(*import(typeB.text()));
    EXPECT_NEAR(b->intensityAtUnit({0, -1, 0}), 9, 1e-4);
    for (const auto& [psi, candela] : {std::pair(0.0, 5), {-59.999, 2}, {59.999, 3}, {-61, 0}, {61, 0}, {180, 0}})
        EXPECT_NEAR(a->intensityAtUnit(direction(90, psi)), candela, 1e-4) << psi;
}

TEST_F(IesConvert, FactorsMultiplyAndZeroIsDark) {
    const std::string tail = " 0 90 0 10 20";
    const auto factors = import("TILT=NONE\n2 500 3 2 1 1 2 0 0 0 0.5 2 60" + tail);
    ASSERT_TRUE(factors);
    EXPECT_EQ(factors->getMaxCandela(), 60);
    EXPECT_EQ(factors->getLumens(), 1000);
    const auto dark = import("TILT=NONE\n2 500 3 2 1 1 2 0 0 0 1 0 60" + tail);
    ASSERT_TRUE(dark);
    EXPECT_EQ(dark->getMaxCandela(), 0);
    EXPECT_EQ(dark->getLumens(), 0);
    EXPECT_EQ(dark->getIntensity(0.5f, 0), 0);
}

}  // namespace
}  // namespace OvPhotometrics
