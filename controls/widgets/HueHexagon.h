#pragma once

#include "widgets/CustomControl.h"

#include <array>

namespace Orbane {

// Six sliders laid as the spokes of a hexagon, one per hue: red at the
// right, then anticlockwise yellow, green, cyan, blue and magenta, each
// spoke painted in its hue. A knob sits on its spoke at its value (the
// centre 0, the vertex the maximum). A press takes the spoke nearest the
// mouse's direction and puts its knob where the mouse falls on it; a drag
// moves it along (Ctrl ten times finer). The owner writes on Moved and
// Released.
class HueHexagon : public CustomControl
{
    Q_OBJECT
public:
    static constexpr int32 kSpokes = 6;
    static constexpr float64 kFine = 0.1;

    HueHexagon();
    ~HueHexagon() override;

    std::size_t SizeOf() const override { return sizeof(HueHexagon); }

    void SetValues(const std::array<float64, kSpokes> &values);
    const std::array<float64, kSpokes> &Values() const noexcept { return mValues; }
    void SetMaximum(float64 max);

    QPointF Centre() const;
    float64 Radius() const;
    // The unit direction of spoke `i` on screen (y down).
    static QPointF Direction(int32 spoke);
    // The spoke whose direction is nearest that from `centre` to `at`.
    static int32 SpokeToward(QPointF at, QPointF centre);
    // The value at `at` projected on `spoke`, 0..max.
    static float64 ValueOn(QPointF at, QPointF centre, float64 radius, int32 spoke, float64 max);
    // Where the knob of a value lies.
    QPointF KnobAt(int32 spoke, float64 value) const;

signals:
    void Moved(int spoke, float64 value);
    void Released();

protected:
    void paintEvent(QPaintEvent *event) override;
    void mousePressEvent(QMouseEvent *event) override;
    void mouseMoveEvent(QMouseEvent *event) override;
    void mouseReleaseEvent(QMouseEvent *event) override;

private:
    std::array<float64, kSpokes> mValues{};
    float64 mMax = 1.0;
    int32 mDragged = -1;
    QPointF mPressAt;
    float64 mPressValue = 0.0;
};

} // namespace Orbane
