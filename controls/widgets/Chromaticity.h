#pragma once

#include "orbane/Types.h"

#include <string>
#include <vector>

namespace Orbane {

// CIE 1931 xy chromaticities: the spectral locus of the 2-degree standard
// observer, and the primaries and white points of the usual colour spaces.
namespace Chromaticity {

struct XY
{
    float64 x = 0.0, y = 0.0;
};

// One row of the observer table and its chromaticity.
struct SpectralSample
{
    float64 nm;
    float64 xbar, ybar, zbar;
    XY xy;
};

// The observer table (controls/data/cie1931_2deg.csv, compiled in), in
// wavelength order, each row's x = X / (X + Y + Z), y = Y / (X + Y + Z).
const std::vector<SpectralSample> &SpectralLocus();
// Parses such a table ("wavelength_nm,xbar,ybar,zbar" rows; '#' comments and
// the header skipped); rows that do not read are left out.
std::vector<SpectralSample> ParseObserver(const std::string &csv);

// A gamut: three primaries and a white point.
struct Gamut
{
    XY red, green, blue, white;
};

// The colour spaces offered, by name, in menu order: "Rec. 709", "DCI-P3",
// "P3-D65", "Rec. 2020", "ACES AP0", "ACES AP1". Their primaries and whites
// are the published constants (ITU-R BT.709-6, SMPTE RP 431-2, SMPTE EG
// 432-1, ITU-R BT.2020-2, SMPTE ST 2065-1 and the ACEScg document S-2014-004).
const std::vector<std::string> &SpaceNames();
// False where `name` is none of them.
bool StandardGamut(const std::string &name, Gamut &out);

// The point `index` of a gamut: 0 red, 1 green, 2 blue, 3 white.
XY &PointOf(Gamut &g, int32 index);
const XY &PointOf(const Gamut &g, int32 index);

} // namespace Chromaticity
} // namespace Orbane
