#include "components/photo/lid/gridEvaluation.h"

#include <algorithm>
#include <cstring>
#include <limits>

#include "components/photo/lid/webEvaluation.h"

namespace OvPhotometrics {

namespace {

// Directions are taken in groups, step by step for the whole group, in loops without branches that compilers turn
// into wide instructions. Each function is inlined into one copy of them all for every kind of machine; no product
// and sum are fused in any copy, so that all give the same results.
#define OVPHOTO_IN_EACH_COPY inline __attribute__((always_inline))

constexpr int groupSize = 64;

/// A list of angles to be searched.
struct Axis {
    Axis(const float* list, int count, float widthBehind) : angles(list), last(count - 1), lastWidth(widthBehind) {
        const float range = list[last] - list[0];
        stepsPerRadian = range > 0 ? static_cast<float>(last) / range : 0;
    }

    const float* angles;
    int last;              // the last index
    float lastWidth;       // of what lies behind the last angle
    float stepsPerRadian;  // where the list is even
};

/// The grid with what its directions have in common.
struct Search {
    explicit Search(const WebGrid& web)
        : grid(web),
          thetas(web.thetas, web.nthetas, 0),
          psis(web.psis, web.npsis, 0),
          axial(web.symmetry == PhotoWebSymmetry::Axial) {
        const float lastPsi = web.psis[psis.last];
        psis.lastWidth = web.symmetry == PhotoWebSymmetry::Full ? twoPi - (lastPsi - web.psis[0])
                                                                : lastPsi - web.psis[std::max(psis.last - 1, 0)];
        if (web.psiTruncated && !axial) darkBehindPsi = lastPsi;
    }

    WebGrid grid;
    Axis thetas, psis;
    bool axial;
    float darkBehindPsi = std::numeric_limits<float>::infinity();
};

/// Where the angles of a group lie in a list: behind which angle, and how far on the way to the next.
struct Places {
    int index[groupSize];
    float fraction[groupSize];
};

OVPHOTO_IN_EACH_COPY void findPlaces(const Axis& axis, const float* angles, int count, Places& places) {
    const float* const list = axis.angles;
    const int last = axis.last;
    const float first = list[0];
    const float lastWidth = axis.lastWidth;
    const int lastGuess = std::max(last - 1, 0);
    // Most lists are even: guess and look at the neighbours.
    for (int k = 0; k < count; ++k) {
        const float a = angles[k];
        float steps = (a - first) * axis.stepsPerRadian;
        steps = steps > 0 ? steps : 0;
        steps = steps < static_cast<float>(lastGuess) ? steps : static_cast<float>(lastGuess);
        int i = std::min(static_cast<int>(steps), lastGuess);
        i += (list[std::min(i + 1, last)] <= a) - (list[i] > a);
        places.index[k] = std::clamp(i, 0, last);
    }

    // Where one of the guesses is wrong all are searched for.
    int found = 1;
    for (int k = 0; k < count; ++k) {
        const float a = angles[k];
        const int i = places.index[k];
        const float here = list[i];
        const float next = list[std::min(i + 1, last)];
        found &= ((i == 0) | (here <= a)) & ((i == last) | (a < next));
    }
    if (!found)
        for (int k = 0; k < count; ++k) places.index[k] = lastAtMost(list, last + 1, angles[k]);

    // The way to the next angle, as a share of the step.
    for (int k = 0; k < count; ++k) {
        const float a = angles[k];
        const int i = places.index[k];
        const float step = list[std::min(i + 1, last)] - list[i];
        const float width = i < last ? step : lastWidth;
        const float way = a - list[i];
        const bool between = (width > 0) & (a >= first);
        places.fraction[k] = (between ? way : 0) / (between ? width : 1);
    }
}

/// The four values of row j around column i.
OVPHOTO_IN_EACH_COPY void fetchRow(const WebGrid& grid, int j, int i, float* out) {
    const float* const row = grid.values + static_cast<std::size_t>(j) * static_cast<std::size_t>(grid.nthetas);
    if (i > 0 && i + 2 < grid.nthetas) {
        std::memcpy(out, row + i - 1, 4 * sizeof *out);
    } else {
        for (int k = 0; k < 4; ++k) out[k] = row[std::clamp(i - 1 + k, 0, grid.nthetas - 1)];
    }
}

OVPHOTO_IN_EACH_COPY void cubics(const float* __restrict p, const float* __restrict t, int count,
                                 float* __restrict out) {
    for (int k = 0; k < count; ++k) out[k] = catmullRom(p + 4 * k, t[k]);
}

OVPHOTO_IN_EACH_COPY void evaluateGroup(const Search& search, const float* angles, int count, float* out) {
    // Fold the directions into the stored range; see which of them are lit.
    const WebGrid& grid = search.grid;
    float theta[groupSize];
    float psi[groupSize];
    int lit[groupSize];
    for (int k = 0; k < count; ++k) {
        const float t = angles[2 * k];
        const float p = angles[2 * k + 1];
        theta[k] = t < 0 ? 0 : t > pi ? pi : t;
        psi[k] = detail::foldPsi(p, grid.symmetry);
        lit[k] = (p == p) & (theta[k] >= grid.thetas[0]) & (theta[k] <= grid.thetas[search.thetas.last]) &
                 !(psi[k] > search.darkBehindPsi);
    }

    // Find the cells of the grid.
    Places columns;
    findPlaces(search.thetas, theta, count, columns);

    // Fetch 4 values around each direction, or 4 by 4, and interpolate along theta, then along psi.
    float block[groupSize * 16];
    float results[groupSize];
    if (search.axial) {
        for (int k = 0; k < count; ++k) fetchRow(grid, 0, columns.index[k], block + 4 * k);
        cubics(block, columns.fraction, count, results);
    } else {
        Places rows;
        findPlaces(search.psis, psi, count, rows);
        float alongTheta[groupSize * 4];
        float alongPsi[groupSize * 4];
        for (int k = 0; k < count; ++k) {
            const int j = rows.index[k];
            const int i = columns.index[k];
            float* const values = block + 16 * k;
            if (j > 0 && j + 2 < grid.npsis)
                for (int r = 0; r < 4; ++r) fetchRow(grid, j - 1 + r, i, values + 4 * r);
            else
                for (int r = 0; r < 4; ++r)
                    fetchRow(grid, photoWebFoldPsiIndex(j - 1 + r, grid.npsis, grid.symmetry), i, values + 4 * r);
            for (int r = 0; r < 4; ++r) alongTheta[4 * k + r] = columns.fraction[k];
        }
        cubics(block, alongTheta, 4 * count, alongPsi);
        cubics(alongPsi, rows.fraction, count, results);
    }
    for (int k = 0; k < count; ++k) out[k] = lit[k] ? detail::asLight(results[k]) : 0;
}

OVPHOTO_IN_EACH_COPY void evaluate(const Search& search, const float* angles, std::size_t count, float* out) {
    for (std::size_t done = 0; done < count; done += groupSize)
        evaluateGroup(search, angles + 2 * done, static_cast<int>(std::min<std::size_t>(groupSize, count - done)),
                      out + done);
}

// On Windows GCC does not align the stack for wide registers (its bug 54412).
#if defined(__x86_64__) && !defined(_WIN32)
#define OVPHOTO_WIDE

__attribute__((target("avx2"))) void evaluateAvx2(const Search& search, const float* angles, std::size_t count,
                                                  float* out) {
    evaluate(search, angles, count, out);
}

__attribute__((target("avx512f,avx512vl,avx512dq,avx512bw"))) void evaluateAvx512(const Search& search,
                                                                                  const float* angles,
                                                                                  std::size_t count, float* out) {
    evaluate(search, angles, count, out);
}

Instructions detectInstructions() {
    if (__builtin_cpu_supports("avx512f") && __builtin_cpu_supports("avx512vl") &&
        __builtin_cpu_supports("avx512dq") && __builtin_cpu_supports("avx512bw"))
        return Instructions::avx512;
    return __builtin_cpu_supports("avx2") ? Instructions::avx2 : Instructions::common;
}

#else

Instructions detectInstructions() { return Instructions::common; }

#endif

bool isKnown(PhotoWebSymmetry symmetry) {
    return symmetry >= PhotoWebSymmetry::Full && symmetry <= PhotoWebSymmetry::Axial;
}

}  // namespace

Instructions widestInstructions() {
    static const Instructions widest = detectInstructions();
    return widest;
}

void evaluateGrid(const WebGrid& grid, const float* angles, std::size_t count, float* out,
                  [[maybe_unused]] Instructions instructions) {
    if (grid.nthetas <= 0 || grid.npsis <= 0 || !isKnown(grid.symmetry)) {
        std::fill_n(out, count, 0.0f);
        return;
    }
    const Search search(grid);
#ifdef OVPHOTO_WIDE
    if (instructions == Instructions::avx512) return evaluateAvx512(search, angles, count, out);
    if (instructions == Instructions::avx2) return evaluateAvx2(search, angles, count, out);
#endif
    evaluate(search, angles, count, out);
}

}  // namespace OvPhotometrics
