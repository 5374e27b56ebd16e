#include "widgets/Chromaticity.h"

#include <cstdio>
#include <sstream>

namespace Orbane {
namespace Chromaticity {

namespace {

const char kObserverCsv[] =
#include "Cie1931Data.inc"
    ;

struct NamedGamut
{
    const char *name;
    Gamut gamut;
};

// White points: D65 (0.3127, 0.3290), DCI (0.314, 0.351), ACES (0.32168, 0.33767).
const NamedGamut kSpaces[] = {
    {"Rec. 709", {{0.640, 0.330}, {0.300, 0.600}, {0.150, 0.060}, {0.3127, 0.3290}}},
    {"DCI-P3", {{0.680, 0.320}, {0.265, 0.690}, {0.150, 0.060}, {0.314, 0.351}}},
    {"P3-D65", {{0.680, 0.320}, {0.265, 0.690}, {0.150, 0.060}, {0.3127, 0.3290}}},
    {"Rec. 2020", {{0.708, 0.292}, {0.170, 0.797}, {0.131, 0.046}, {0.3127, 0.3290}}},
    {"ACES AP0", {{0.7347, 0.2653}, {0.0, 1.0}, {0.0001, -0.0770}, {0.32168, 0.33767}}},
    {"ACES AP1", {{0.713, 0.293}, {0.165, 0.830}, {0.128, 0.044}, {0.32168, 0.33767}}},
};

} // namespace

std::vector<SpectralSample> ParseObserver(const std::string &csv)
{
    std::vector<SpectralSample> rows;
    std::istringstream in(csv);
    std::string line;
    while (std::getline(in, line)) {
        SpectralSample s{};
        if (line.empty() || line[0] == '#' ||
            std::sscanf(line.c_str(), "%lf,%lf,%lf,%lf", &s.nm, &s.xbar, &s.ybar, &s.zbar) != 4)
            continue;
        const float64 sum = s.xbar + s.ybar + s.zbar;
        if (sum <= 0.0)
            continue;
        s.xy = {s.xbar / sum, s.ybar / sum};
        rows.push_back(s);
    }
    return rows;
}

const std::vector<SpectralSample> &SpectralLocus()
{
    static const std::vector<SpectralSample> locus = ParseObserver(kObserverCsv);
    return locus;
}

const std::vector<std::string> &SpaceNames()
{
    static const std::vector<std::string> names = [] {
        std::vector<std::string> n;
        for (const NamedGamut &s : kSpaces)
            n.emplace_back(s.name);
        return n;
    }();
    return names;
}

bool StandardGamut(const std::string &name, Gamut &out)
{
    for (const NamedGamut &s : kSpaces)
        if (name == s.name) {
            out = s.gamut;
            return true;
        }
    return false;
}

XY &PointOf(Gamut &g, int32 index)
{
    return index == 0 ? g.red : index == 1 ? g.green : index == 2 ? g.blue : g.white;
}

const XY &PointOf(const Gamut &g, int32 index)
{
    return index == 0 ? g.red : index == 1 ? g.green : index == 2 ? g.blue : g.white;
}

} // namespace Chromaticity
} // namespace Orbane
