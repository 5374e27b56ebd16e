#pragma once

#include "widgets/CustomControl.h"

#include <QColor>

namespace Orbane {

// The tiled patterns a pattern control offers, and a painted, checkable
// preview of one of them. Which pixels a pattern inks is a pure function
// (Inked), so the previews and the tests agree on what each looks like.
class PatternSwatch : public CustomControl
{
    Q_OBJECT
public:
    enum Pattern : int32
    {
        Checker,
        HStripes,
        VStripes,
        Diagonal,
        Dots,
        Grid,
        PatternCount
    };
    static const char *Name(int32 pattern);
    // Does `pattern` ink the pixel (x, y) with tiles `tile` pixels wide?
    static bool Inked(int32 pattern, int32 x, int32 y, int32 tile);

    explicit PatternSwatch(int32 pattern);
    ~PatternSwatch() override;

    std::size_t SizeOf() const override { return sizeof(PatternSwatch); }

    int32 GetPattern() const noexcept { return mPattern; }
    void SetChosen(bool chosen);
    bool IsChosen() const noexcept { return mChosen; }
    void SetLook(int32 tile, const QColor &ink);

signals:
    void Clicked(int pattern);

protected:
    void paintEvent(QPaintEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;

private:
    int32 mPattern;
    bool mChosen = false;
    int32 mTile = 8;
    QColor mInk = QColor(230, 230, 230);
};

} // namespace Orbane
