#pragma once

#include "orbane/FloatImage.h"

#include <QImage>
#include <QString>

#include <functional>

namespace Orbane {

// Reads image files from outside (comps, tools, look packs, scripts). The
// size is read from the file's header first, and an image of more than
// kMaxPixels is refused before any pixel memory is allocated; a corrupt or
// unreadable file gives a null image and the reason.
//
// Two readers: Qt's for what it knows (the look pack's PNG and SVG skins,
// exactly as Qt draws them), and OpenImageIO for the pictures a compositor
// works on (EXR, DPX, TIFF, PNG ...), read into linear floats.
class ImageFile
{
public:
    static constexpr qint64 kMaxPixels = qint64(1) << 26; // 64 megapixels, 8192 x 8192

    // What a file's header says.
    struct Header
    {
        int32 width = 0, height = 0;
        int32 channels = 0;   // in the file; at most four are read
        bool isFloat = false; // half or float samples: linear light
        QString format;       // "openexr", "png" ...
    };

    // The image, or a null one with *error set. What Qt cannot read (EXR,
    // DPX) is read through OpenImageIO and shown as ToDisplay makes it.
    static QImage Read(const QString &path, QString *error = nullptr);
    // Only the checks Read makes before decoding: the file exists, can be
    // read as an image, and is within the pixel limit.
    static bool Check(const QString &path, QString *error = nullptr);

    // Through OpenImageIO: the header, with the pixel limit checked.
    static bool ReadHeader(const QString &path, Header *header, QString *error = nullptr);
    // Through OpenImageIO: the first four channels (the first of several
    // subimages) as linear light. Integer samples are taken as sRGB-encoded
    // unless the file says they are linear; float samples as linear unless
    // it says sRGB. `progress` is told the part done (0..1), from the
    // thread that reads; returning false stops the read.
    using Progress = std::function<bool(float done)>;
    static FloatImage ReadLinear(const QString &path, QString *error = nullptr, const Progress &progress = {});
};

} // namespace Orbane
