#pragma once

#include "orbane/TagMapEntry.h"
#include "orbane/Tags.h"

namespace Orbane {

// Script tags of TrackerControl, a tracker's pattern and search boxes over
// its tracked point; described in docs/overlays.md, defaults in brackets.
// The boxes' sizes are Point Inputs of the overlay (width, height as parts
// of the image's width and height), named by their index among its Inputs
// (-1: the overlay keeps the size itself).
constexpr Tag TRC_PatternInput = 0x10058000;  // [1]
constexpr Tag TRC_SearchInput = 0x10058001;   // [2]
constexpr Tag TRC_ShowPath = 0x10058002;      // the tracked path through the point's keys [on]
constexpr Tag TRC_PathFrames = 0x10058003;    // frames of path shown each side of the current one [0: all]
constexpr Tag TRC_PatternUpdate = 0x10058004; // Fixed: the first frame's pattern throughout;
                                              // EveryFrame: taken again where it was found [Fixed]
constexpr Tag TRC_SubPixel = 0x10058005;      // positions between pixels [on]
constexpr Tag TRC_PathColor = 0x10058006;     // the path [the overlay colour]
constexpr Tag TRC_BoxColor = 0x10058007;      // the boxes [the overlay colour]
constexpr Tag TRCD_MinScore = 0x20058000;     // match score (-1..1) below which tracking stops [0.5]

extern const TagMapEntry TrackerControlTags[];

} // namespace Orbane
