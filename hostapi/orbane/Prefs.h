#pragma once

#include "orbane/Tags.h"

namespace Orbane {

// Preference ids: tags of the document's preference list (OrbaneDoc::GetPrefs),
// in a group of their own.
constexpr uint32 TAGGROUP_Prefs = 0x10;

enum PrefTag : Tag
{
    // How the polyline overlay exports splines (0: points, 1: the spline).
    PREF_ExportSplineMode = MakeTag(TAGTYPE_Long, TAGGROUP_Prefs, 0),
    // Whether a selection rectangle may pick points of several polylines.
    PREF_SelectPointsFromMultiPolies = MakeTag(TAGTYPE_Long, TAGGROUP_Prefs, 1),
    // The image file the viewer shows (a comp's `image`); none: a checkerboard.
    PREF_ViewerImage = MakeTag(TAGTYPE_String, TAGGROUP_Prefs, 2),
    // The width of one pixel of that image over its height (a comp's
    // `pixelAspect`; 2 for a 2:1 squeeze). None or not positive: 1.
    PREF_ViewerPixelAspect = MakeTag(TAGTYPE_Double, TAGGROUP_Prefs, 3),
    // The folder of the comp file loaded last: file Inputs asked to be
    // relative are relative to it. None: the current directory.
    PREF_CompFolder = MakeTag(TAGTYPE_String, TAGGROUP_Prefs, 4),
};

} // namespace Orbane
