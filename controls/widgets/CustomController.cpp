#include "widgets/CustomController.h"

#include "orbane/DIB.h"
#include "orbane/StateDIBs.h"
#include "orbane/TimeCodeEdit.h"

#include <QMetaType>

namespace Orbane {

namespace {

// The signal arguments are spelled with the host's type names; queued
// connections and signal spies look them up by those names.
void RegisterSignalTypes()
{
    static const bool done = [] {
        qRegisterMetaType<float64>("float64");
        qRegisterMetaType<CustomController *>("CustomController*");
        qRegisterMetaType<TimeCodeEdit *>("TimeCodeEdit*");
        return true;
    }();
    (void)done;
}

} // namespace

CustomController::CustomController(const Registry *reg, const ScriptVal &args, const TagList &tags)
    : CustomControl(reg, args, tags)
{
    RegisterSignalTypes();
}

CustomController::~CustomController()
{
    StoreImage(mKnobImageThird, nullptr);
    StoreImage(mKnobImageSecond, nullptr);
    StoreImage(mResetImage, nullptr);
    StoreImage(mKnobImagePressed, nullptr);
    StoreImage(mKnobImage, nullptr);
}

void CustomController::StoreImage(DIB *&slot, DIB *image)
{
    if (image)
        image->Use();
    if (slot)
        slot->Recycle();
    slot = image;
}

OrbRectT<int32> CustomController::ImageRect(const DIB *image)
{
    if (!image)
        return OrbRectT<int32>();
    const int32 w = image->Width(), h = image->Height();
    return OrbRectT<int32>(-(w / 2), 0, w - w / 2, h);
}

void CustomController::LayoutKnob(int32 trackHeight, int32 knobHeight, int32 resetHeight, int32 offset, int32 &knobTop,
                                  int32 &resetTop)
{
    // A knob lifted above the track (negative offset) leaves the reset
    // marker's room out of the centring.
    const int32 reserved = offset >= 0 ? offset + resetHeight : -offset;
    knobTop = (trackHeight - reserved - knobHeight) / 2 - (offset < 1 ? offset : 0);
    resetTop = offset >= 0 ? knobTop + knobHeight + offset : knobTop + offset;
}

void CustomController::SetDefault(float64 value, bool redraw)
{
    mDefault = value;
    mResetHeight = HasDefault() && mResetImage ? mResetImage->Height() : 0;
    mResetRect = ImageRect(mResetImage);
    if (redraw)
        Redraw(true);
}

void CustomController::KnobImagesChanged()
{
    mKnobRect = ImageRect(mKnobImage);
    SetTrackRect(mTrackRect);
    Redraw(false);
}

void CustomController::SetKnobImages(StateDIBs *first, StateDIBs *second)
{
    StoreImage(mKnobImage, first ? first->GetState(0) : nullptr);
    StoreImage(mKnobImageSecond, first ? first->GetState(1) : nullptr);
    StoreImage(mKnobImageThird, second ? second->GetState(0) : nullptr);
    StoreImage(mKnobImagePressed, second ? second->GetState(1) : nullptr);
    KnobImagesChanged();
}

void CustomController::SetKnobImage(DIB *first, DIB *second)
{
    StoreImage(mKnobImage, first);
    StoreImage(mKnobImageSecond, first);
    StoreImage(mKnobImageThird, first);
    StoreImage(mKnobImagePressed, second);
    KnobImagesChanged();
}

void CustomController::SetResetImage(DIB *image)
{
    StoreImage(mResetImage, image);
    mResetHeight = HasDefault() && mResetImage ? mResetImage->Height() : 0;
    mResetRect = ImageRect(mResetImage);
    Redraw(true);
}

float64 CustomController::MapValue(float64 value)
{
    return value;
}

void CustomController::AttachEdit(TimeCodeEdit *edit)
{
    if (!edit)
        return;
    edit->SetVirtual(true);
    // Spelt in Qt's normalised form, which it finds at once; any other
    // spelling is looked up, normalised and looked up again, on every slider.
    connect(edit, "2StartDrag(TimeCodeEdit*)", this, "1OnEditStartDrag(TimeCodeEdit*)");
    connect(edit, "2EndDrag(TimeCodeEdit*)", this, "1OnEditEndDrag(TimeCodeEdit*)");
    connect(edit, "2Drag(float64,TimeCodeEdit*)", this, "1OnEditDrag(float64,TimeCodeEdit*)");
}

void CustomController::SetTrackRect(const OrbRectT<int32> &rect)
{
    mTrackRect = rect;
    if (!mKnobImage)
        return;
    LayoutKnob(rect.Height(), mKnobImage->Height(), mResetHeight, mKnobOffset, mKnobTop, mResetTop);
}

void CustomController::SetKnobOffset(int32 offset)
{
    mKnobOffset = offset;
}

void CustomController::SetExponent(float64 exponent)
{
    if (exponent > 0.0 && exponent != mExponent) {
        mExponent = exponent;
        Redraw(true);
    }
}

void CustomController::Redraw(bool) {}
void CustomController::SetRange(float64, float64) {}
void CustomController::SetScale(float64, float64, bool) {}
void CustomController::SetAllowedRange(float64, float64, bool) {}
void CustomController::SetTickCount(int32) {}
void CustomController::SetCentre(float64) {}
void CustomController::SetValue(float64, bool) {}
void CustomController::SetSliderValue(float64) {}
void CustomController::OnEditStartDrag(TimeCodeEdit *) {}
void CustomController::OnEditEndDrag(TimeCodeEdit *) {}
void CustomController::OnEditDrag(float64, TimeCodeEdit *) {}

} // namespace Orbane
