#pragma once

#include "framework/LabelledInputControl.h"

#include "orbane/AutoRef.h"
#include "orbane/ImageParam.h"

#include <QImage>

class QLabel;

namespace Orbane {

// A thumbnail of an Image Input with its size and channels: "thumbnail",
// the image scaled to fit over a checkerboard (so alpha shows), and "info",
// "<width> x <height>, <channels> <depth>" or why there is no image ("no
// image", "cannot read <file>"). It only shows: the image is chosen
// elsewhere (a file control, a script). No tags: it follows its Input.
class ImageControl : public LabelledInputControl
{
    Q_OBJECT
public:
    ImageControl(const Registry *reg, const ScriptVal &args, const TagList &tags);
    ~ImageControl() override;

    std::size_t SizeOf() const override { return sizeof(ImageControl); }

    bool Open(QWidget *host, const QRect &rect, const TagList *tags) override;
    bool NotifyChanged(Input *input, Parameter *value, const TagList *tags) override;
    bool UpdateDisplay(Input *input, const TagList *tags) override;
    bool OnDisconnect(Input *input, const TagList *tags) override;

    // "RGBA 8-bit", "Grey 16-bit" ...: what a person calls the image's pixels.
    static QString Describe(const QImage &image);

private:
    void ShowValue();

    AutoRef<ImageParam> mValue;
    QLabel *mThumbnail;
    QLabel *mInfo;
};

} // namespace Orbane
