#pragma once

#include "orbane/Types.h"

#include <QString>

#include <vector>

namespace Orbane {

// An image or image sequence on disk, found from one path: a file of the
// sequence ("plate.0012.exr") or its pattern with the frame digits as '#'
// ("plate.####.exr") or as a printf field ("plate.%04d.exr", "plate.%d.exr":
// digits without padding). The frame number is the last run of digits (or
// '#') in the file name; every file of the folder with the same text around a
// run of that many digits belongs to it (a longer run where the number needs
// it: frame 10000 of "####").
struct ClipSequence
{
    QString pattern; // the path with the frame as '#'s; a still image's path as given
    int32 first = 0; // the first and last frame found
    int32 last = -1;
    int32 count = 0;           // files found
    int32 padding = 0;         // digits of the frame; 0: a still image
    std::vector<int32> frames; // the frames found, in order

    bool IsSequence() const { return padding > 0; }
    bool IsEmpty() const { return count == 0; }
    // Frames between the first and the last that have no file.
    int32 Gaps() const { return IsSequence() && count ? last - first + 1 - count : 0; }
    bool HasFrame(int32 frame) const;
    // The frame a viewer holds where `frame` has no file: the last one
    // before it, else the first after it; `frame` itself where it is there.
    // No frames at all: `frame`.
    int32 HeldFrame(int32 frame) const;
    // The file of `frame`.
    QString FrameFile(int32 frame) const;
    // "1001-1024 (24 frames)", "still image", "no frames found" ...
    QString Describe() const;

    static ClipSequence Detect(const QString &path);
    // Does the path name its frame by a pattern ('#' or a printf field)
    // rather than by a file?
    static bool IsPattern(const QString &path);
};

} // namespace Orbane
