#pragma once

#include <QImage>
#include <QString>

namespace Orbane {

// Reads image files from outside (comps, tools, look packs, scripts). The
// size is read from the file's header first, and an image of more than
// kMaxPixels is refused before any pixel memory is allocated; a corrupt or
// unreadable file gives a null image and the reason.
class ImageFile
{
public:
    static constexpr qint64 kMaxPixels = qint64(1) << 26; // 64 megapixels, 8192 x 8192

    // The image, or a null one with *error set.
    static QImage Read(const QString &path, QString *error = nullptr);
    // Only the checks Read makes before decoding: the file exists, can be
    // read as an image, and is within the pixel limit.
    static bool Check(const QString &path, QString *error = nullptr);
};

} // namespace Orbane
