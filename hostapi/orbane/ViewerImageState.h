#pragma once

#include "orbane/Types.h"

#include <QString>

namespace Orbane {

// What the viewer shows of its image or sequence, and how far it has come
// reading it: what a person reads off the viewer's status line.
struct ViewerImageState
{
    QString source;        // the path or pattern asked for; empty: none (a checkerboard)
    QString file;          // the file shown, or being read
    bool sequence = false; // the source is a pattern of frames
    int32 frame = 0;       // the frame of the current time
    int32 shownFrame = 0;  // the frame shown: an earlier one where `frame` is missing
    int32 first = 0;       // the frames found on disk
    int32 last = -1;
    int32 width = 0; // of the file shown or being read, from its header
    int32 height = 0;
    int32 channels = 0;    // read: at most four
    bool loading = false;  // the pixels are being read in the background
    float progress = 0.0f; // of that read, 0..1
    QString error;         // why the image (or the asked frame) is not shown; empty: all is well
};

} // namespace Orbane
