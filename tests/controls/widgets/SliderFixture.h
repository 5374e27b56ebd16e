#pragma once

#include "widgets/CustomSlider.h"

#include "orbane/DIB.h"

namespace Orbane {

// A slider whose track runs from pixel 5 to pixel 205 (an 11-pixel knob on a
// 211-pixel widget): 200 pixels for the soft range.
struct SliderFixture
{
    static constexpr int Width = 211, Height = 24;

    CustomSlider *slider = new CustomSlider;
    DIB *knob = new DIB(11, 14);
    DIB *held = new DIB(11, 14);
    DIB *marker = new DIB(7, 5);

    SliderFixture(double min = 0.0, double max = 1.0)
    {
        knob->Fill(QColor(200, 200, 200));
        held->Fill(QColor(240, 160, 60));
        marker->Fill(QColor(150, 150, 150));
        slider->SetKnobImage(knob, held);
        slider->SetResetImage(marker);
        SetRange(min, max);
        slider->SetTrackRect(OrbRectT<int32>(0, 0, Width, Height));
        slider->resize(Width, Height);
    }
    ~SliderFixture()
    {
        delete slider;
        knob->Recycle();
        held->Recycle();
        marker->Recycle();
    }
    void SetRange(double min, double max)
    {
        slider->SetAllowedRange(min, max, false);
        slider->SetScale(min, max, false);
        slider->SetRange(min, max);
    }
};

} // namespace Orbane
