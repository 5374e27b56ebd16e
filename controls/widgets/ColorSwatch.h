#pragma once

#include "widgets/ColorMath.h"
#include "widgets/CustomControl.h"

namespace Orbane {

// A painted patch of one colour: the left half opaque, the right half over
// a checkerboard with the colour's alpha. Values outside 0..1 are shown
// clipped, with a small triangle in the corner that says so (HDR or
// negative); NaN shows as black with the same mark. A double click asks the
// owner for the system colour dialog (DoubleClicked).
class ColorSwatch : public CustomControl
{
    Q_OBJECT
public:
    ColorSwatch();
    ~ColorSwatch() override;

    std::size_t SizeOf() const override { return sizeof(ColorSwatch); }

    void SetColor(const ColorRGBA &colour);
    const ColorRGBA &Color() const noexcept { return mColor; }
    // Does any channel lie outside what the screen can show?
    static bool IsOutOfRange(const ColorRGBA &colour);

signals:
    void DoubleClicked();

protected:
    void paintEvent(QPaintEvent *event) override;
    void mouseDoubleClickEvent(QMouseEvent *event) override;

private:
    ColorRGBA mColor;
};

} // namespace Orbane
