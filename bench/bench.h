#pragma once

#include <benchmark/benchmark.h>

#include <string>
#include <vector>

#include "components/photo/lid/photoWeb.h"
#include "host/componentManager/bufferedIO.h"
#include "ovphoto/classIds.h"

// What the benchmarks share. Ours stands beside a floor in the same run; what counts is the ratio of both. Inputs
// are generated with fixed seeds.

namespace bench {

/// A line of the table at the end: one benchmark over another, by their rates where they count bytes, else by their
/// times. There is none where they are not run.
struct Ratio {
    std::string what;
    std::string ours;
    std::string floor;
    double atMost = 0;   // the wanted bound; 0: none
    double atLeast = 0;  // the same of rates
};

/// Adds lines to the table; done while the program starts.
bool addRatios(std::initializer_list<Ratio> ratios);
const std::vector<Ratio>& ratios();

/// An IES file, type C: vertical angles 0 to 180, planes 0 to 360 or, open, up to the last before 360. Values have
/// one or two decimals; lines run to 130 characters. Without lumens the flux is to be integrated.
std::string iesText(int verticalCount, int horizontalCount, bool closed);

/// @{
/// A text, or what a device holds from its start, imported through the builder of a class.
Ov::RnRef<Ov::RnPhotoWebData> import(const Ov::RnUid& classId, const std::string& text);
Ov::RnRef<Ov::RnPhotoWebData> import(const Ov::RnUid& classId, Ov::RnBufferedIO& io);
/// @}
/// Imports `iesText`, open.
Ov::RnRef<Ov::RnPhotoWebData> webOf(int verticalCount, int horizontalCount);
/// A web as a file of a format.
std::string fileText(const Ov::RnUid& classId, Ov::RnPhotoWebData& web);

/// Angles of `count` directions: theta 0 to pi, psi 0 to 2 pi, spread evenly.
std::vector<float> randomAngles(std::size_t count);

/// Says how long one of `count` things takes that an iteration does.
void countEach(benchmark::State& state, std::size_t count);
void countBytes(benchmark::State& state, std::size_t bytes);

/// Converts every number in a text, whatever stands between them; the result is their sum.
float walkNumbers(const std::string& text);

}  // namespace bench
