// CustomSlider's event handlers: mouse, keys, page repeat, hover and painting.
#include "widgets/CustomSlider.h"

#include "widgets/SkinImages.h"

#include "orbane/DIB.h"
#include "orbane/Gradient.h"
#include "orbane/TimeCodeEdit.h"

#include <QKeyEvent>
#include <QMouseEvent>
#include <QPaintEvent>
#include <QPainter>

#include <algorithm>
#include <cmath>

namespace Orbane {

namespace {

// The hit rectangles reach past the images, so that a small knob or marker
// is easy to catch and a page press may start just outside the track.
constexpr int32 KnobSlackX = 5, KnobSlackY = 4, ResetSlack = 5, TrackSlack = 10;
// How much a hovered or held knob without an image of its own is lightened.
constexpr int32 HighlightLightness = 15;
// A disabled slider draws its knob faded.
constexpr qreal DisabledOpacity = 0.4;

QRect RectAt(const OrbRectT<int32> &r, int32 x, int32 y)
{
    return QRect(x + r.x1, y + r.y1, r.Width(), r.Height());
}

float64 Clamp(float64 v, float64 lo, float64 hi)
{
    return v < lo ? lo : v > hi ? hi : v;
}

} // namespace

// ---- hit rectangles ----

QRect CustomSlider::KnobHitRect() const
{
    if (!mKnobImage)
        return QRect();
    return RectAt(mKnobRect, KnobX(), mTrackRect.y1 + mKnobTop)
        .adjusted(-KnobSlackX, -KnobSlackY, KnobSlackX, KnobSlackY);
}

QRect CustomSlider::ResetHitRect() const
{
    if (!HasDefault() || !mResetImage || mResetImage->Height() <= 0)
        return QRect();
    const int32 x = int32(std::floor(ValueToPixel(mDefault) + 0.5));
    return RectAt(mResetRect, x, mTrackRect.y1 + mResetTop).adjusted(-ResetSlack, -ResetSlack, ResetSlack, ResetSlack);
}

bool CustomSlider::OnTrackRows(int32 y) const
{
    return y >= mTrackRect.y1 && y < mTrackRect.y2;
}

// ---- mouse ----

void CustomSlider::mousePressEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton)
        return CustomController::mousePressEvent(event);
    if (mDisabled || rect().isEmpty())
        return;
    const int32 x = event->pos().x(), y = event->pos().y();
    setFocus(Qt::OtherFocusReason);
    mPressValue = mValue;
    StopRepeat();
    mDragKnob = mPageDown = mPageUp = mResetArmed = false;
    mMoved = mFineKey = mCoarseKey = false;
    emit Pressed(this);

    if (event->modifiers() & Qt::AltModifier) {
        // The reset is the gesture's one change, made at release.
        mResetArmed = mFirstChange = HasDefault();
        return;
    }
    if (KnobHitRect().contains(x, y)) {
        mDragKnob = mFirstChange = true;
        mLastX = x;
        mMapping.SetAnchor(mValue);
        mGrabOffset = x - ValueToPixel(mValue);
        MoveHandler(x, y, event->modifiers());
        Redraw(true);
        OwnerAutoProxy(true);
        return;
    }
    if (ResetHitRect().contains(x, y)) {
        mResetArmed = mFirstChange = true;
        Redraw(true);
        return;
    }
    if (OnTrackRows(y))
        PressTrack(x, event->modifiers() & Qt::ControlModifier);
}

void CustomSlider::PressTrack(int32 x, bool fine)
{
    const QRect knob = RectAt(mKnobRect, KnobX(), 0);
    mPageDown = x < knob.left() && x > mTrackRect.x1 - TrackSlack;
    mPageUp = x > knob.right() && x < mTrackRect.x2 + TrackSlack;
    if (!mPageDown && !mPageUp)
        return;
    mFineKey = fine;
    mFirstChange = true;
    Step(mPageDown ? -1 : 1, fine ? STEP_Fine : STEP_Coarse);
    mRepeating = true;
    mRepeatCount = RepeatDelay;
    mTimerId = startTimer(RepeatInterval, Qt::CoarseTimer);
}

void CustomSlider::mouseMoveEvent(QMouseEvent *event)
{
    MoveHandler(event->pos().x(), event->pos().y(), event->modifiers());
}

void CustomSlider::MoveHandler(int32 x, int32 y, Qt::KeyboardModifiers modifiers)
{
    if (!(modifiers & Qt::AltModifier))
        UpdateHover(x, y);
    if (!mDragKnob || (x == mLastX && !mMoved))
        return;
    mMoved = true;
    mLastX = x;
    DragTo(x, modifiers & Qt::ControlModifier ? 0.1 : 1.0);
}

void CustomSlider::DragTo(int32 x, float64 k)
{
    const std::optional<float64> def = HasDefault() ? std::optional<float64>(mDefault) : std::nullopt;
    const float64 v = Mapping().DragValue(x - mGrabOffset, k, mPressValue, def);
    update();
    SetSliderValue(v);
}

void CustomSlider::mouseReleaseEvent(QMouseEvent *event)
{
    if (event->button() != Qt::LeftButton)
        return CustomController::mouseReleaseEvent(event);
    const int32 x = event->pos().x(), y = event->pos().y();
    if (mResetArmed && HasDefault() && (ResetHitRect().contains(x, y) || (event->modifiers() & Qt::AltModifier)))
        SetSliderValue(mDefault);
    const bool dragged = mDragKnob;
    if (dragged)
        OwnerAutoProxy(false);
    MoveHandler(x, y, event->modifiers());
    EndGesture();
    Redraw(true);
    if (dragged)
        OwnerSyncRender();
    OwnerResetUndo();
}

void CustomSlider::EndGesture()
{
    mDragKnob = mPageDown = mPageUp = mResetArmed = false;
    mFirstChange = false;
    StopRepeat();
    emit Released(this);
}

void CustomSlider::StopRepeat()
{
    if (mTimerId)
        killTimer(mTimerId);
    mTimerId = 0;
    mRepeatCount = 0;
    mRepeating = false;
}

void CustomSlider::timerEvent(QTimerEvent *event)
{
    if (event->timerId() != mTimerId)
        return CustomController::timerEvent(event);
    if (mRepeatCount > 0) {
        --mRepeatCount;
        return;
    }
    Step(mPageDown ? -1 : 1, mFineKey ? STEP_Fine : STEP_Coarse);
}

// ---- hover ----

void CustomSlider::UpdateHover(int32 x, int32 y)
{
    const bool knob = KnobHitRect().contains(x, y);
    const bool reset = !knob && ResetHitRect().contains(x, y);
    const bool track = !knob && !reset && OnTrackRows(y) && x >= mTrackRect.x1 && x < mTrackRect.x2;
    if (knob == mHoverKnob && reset == mHoverReset && track == mHoverTrack)
        return;
    mHoverKnob = knob;
    mHoverReset = reset;
    mHoverTrack = track;
    update();
}

void CustomSlider::enterEvent(QEvent *event)
{
    setMouseTracking(true);
    CustomController::enterEvent(event);
}

void CustomSlider::leaveEvent(QEvent *event)
{
    setMouseTracking(false);
    if (mHoverKnob || mHoverReset || mHoverTrack) {
        mHoverKnob = mHoverReset = mHoverTrack = false;
        update();
    }
    CustomController::leaveEvent(event);
}

// ---- keys ----

bool CustomSlider::KeyTarget(int32 key) const
{
    switch (key) {
    case Qt::Key_Home:
    case Qt::Key_End:
    case Qt::Key_Left:
    case Qt::Key_Right:
    case Qt::Key_PageUp:
    case Qt::Key_PageDown:
        return true;
    default:
        return false;
    }
}

void CustomSlider::ReAnchor()
{
    // The scaling changes under the cursor: restart it from where the knob
    // is, so the knob stays under the cursor.
    mMapping.SetAnchor(mValue);
    mGrabOffset = mLastX - ValueToPixel(mValue);
}

void CustomSlider::keyPressEvent(QKeyEvent *event)
{
    if (mDisabled)
        return CustomController::keyPressEvent(event);
    if (event->key() == Qt::Key_Control && mDragKnob) {
        ReAnchor();
        return;
    }
    mFineKey = event->modifiers() & Qt::ControlModifier;
    mCoarseKey = event->modifiers() & Qt::ShiftModifier;
    if (!KeyTarget(event->key()))
        return CustomController::keyPressEvent(event);
    const int32 level = mFineKey ? STEP_Fine : mCoarseKey ? STEP_Coarse : STEP_Normal;
    if (!event->isAutoRepeat())
        mFirstChange = true;
    switch (event->key()) {
    case Qt::Key_Home:
        SetSliderValue(mMinScale);
        break;
    case Qt::Key_End:
        SetSliderValue(mMaxScale);
        break;
    case Qt::Key_Left:
    case Qt::Key_PageDown:
        Step(-1, level);
        break;
    default:
        Step(1, level);
        break;
    }
}

void CustomSlider::keyReleaseEvent(QKeyEvent *event)
{
    if (event->key() == Qt::Key_Control && mDragKnob) {
        ReAnchor();
        MoveHandler(mLastX, mTrackRect.y1 + mKnobTop, event->modifiers());
        return;
    }
    if (!mDisabled && KeyTarget(event->key()) && !event->isAutoRepeat()) {
        OwnerResetUndo();
        return;
    }
    CustomController::keyReleaseEvent(event);
}

// ---- virtual edit drag ----

void CustomSlider::OnEditStartDrag(TimeCodeEdit *)
{
    mMapping.SetAnchor(mValue);
    mFirstChange = true;
    OwnerAutoProxy(true);
}

void CustomSlider::OnEditDrag(float64 dist, TimeCodeEdit *edit)
{
    // A thousandth of the owner's range, rounded down to a power of ten.
    float64 range = mLastRangeMax - mLastRangeMin;
    if (!(range > 0.0))
        range = mMaxScale - mMinScale;
    const float64 unit = range > 0.0 ? std::pow(10.0, std::floor(std::log10(range)) - 3) : 0.001;
    const float64 anchor = mMapping.GetAnchor();
    const float64 wanted = anchor + unit * dist;
    const float64 v = Clamp(wanted, mMinScale, mMaxScale);
    SetSliderValue(v);
    if (v != wanted && edit)
        edit->SetDragDistance((v - anchor) / unit);
}

void CustomSlider::OnEditEndDrag(TimeCodeEdit *)
{
    OwnerAutoProxy(false);
    OwnerSyncRender();
    OwnerResetUndo();
}

// ---- painting ----

void CustomSlider::paintEvent(QPaintEvent *event)
{
    if (!BeginDraw(event->rect()))
        return;
    QPainter &painter = *BackPainter();
    const int32 knobY = mTrackRect.y1 + mKnobTop;
    PaintTrack(painter, knobY);
    PaintReset(painter);
    PaintKnob(painter, knobY);
    EndDraw();
}

void CustomSlider::PaintTrack(QPainter &painter, int32 knobY)
{
    DIB *image = SkinImages::Get(SkinImages::SliderTrack);
    if (!image || width() <= 0)
        return;
    TrackKey key;
    key.width = width();
    key.ratio = devicePixelRatioF();
    key.image = image;
    key.gradients[0] = mGradient;
    key.gradients[1] = mGradient2;
    key.serials[0] = mGradient ? mGradient->Serial() : 0;
    key.serials[1] = mGradient2 ? mGradient2->Serial() : 0;
    key.spaces[0] = mColorSpace;
    key.spaces[1] = mColorSpace2;
    key.from = int32(mMapping.PixelMin()) + mKnobRect.x1 - 1;
    key.to = int32(mMapping.PixelMax()) + mKnobRect.x2;
    key.centre = int32(mMapping.PixelCentre());
    key.twoSegment = IsTwoSegment();
    if (!mTrack || !(key == mTrackKey)) {
        StoreImage(mTrack, nullptr);
        mTrack = new DIB(key.width, image->Height(), key.ratio);
        mTrack->FillStretched(*image, QMargins((image->Width() - 2) / 2, 0, (image->Width() - 2) / 2, 0));
        // The gradient reads its pixel range from the key: store it first.
        mTrackKey = key;
        if (mGradient)
            PaintGradient(*mTrack);
    }
    const int32 knobHeight = mKnobImage ? mKnobImage->Height() : 0;
    const int32 y = knobY + (knobHeight - mTrack->Height()) / 2;
    // Only the columns being repainted: a knob move damages a narrow strip.
    const OrbRectT<int32> &d = GetDrawRect();
    const QRect place = mTrack->Rect().translated(0, y).intersected(QRect(d.x1, d.y1, d.Width(), d.Height()));
    mTrack->Merge(painter, place.translated(0, -y), place);
}

// The ramp is drawn once into the cached track, over the columns the knob
// can cover; the repaint clip keeps the rest of a paint cheap.
void CustomSlider::PaintGradient(DIB &track)
{
    const int32 w = track.Width(), h = track.Height();
    if (w < 3 || h < 3)
        return;
    const int32 from = std::max(1, mTrackKey.from), to = std::min(w - 2, mTrackKey.to);
    const int32 split = int32(mMapping.PixelCentre());
    const bool halves = IsTwoSegment() && mGradient2;
    QPainter painter(&track.GetImage());
    for (int32 i = from; i <= to; ++i) {
        const bool right = halves && i >= split;
        const Gradient *ramp = right ? mGradient2 : mGradient;
        float64 pos = float64(i) / (w - 2);
        if (halves)
            pos = right ? float64(i - split) / std::max(1, w - 2 - split) : float64(i) / std::max(1, split);
        const GradientColor c = ramp->QuickEvaluate(pos, right ? mColorSpace2 : mColorSpace);
        QColor colour = QColor::fromRgbF(Clamp(c.R, 0, 1), Clamp(c.G, 0, 1), Clamp(c.B, 0, 1));
        painter.setOpacity(Clamp(c.A, 0, 1));
        painter.fillRect(QRect(i, 1, 1, h - 2), colour);
    }
}

DIB *CustomSlider::Highlighted(DIB *image, DIB *&cache, DIB *&source)
{
    if (!image)
        return nullptr;
    if (source != image || !cache) {
        StoreImage(source, image);
        StoreImage(cache, nullptr);
        cache = image->Copy();
        cache->AdjustHLS(0, HighlightLightness, 0);
    }
    return cache;
}

void CustomSlider::PaintKnob(QPainter &painter, int32 knobY)
{
    if (!mKnobImage)
        return;
    DIB *image = mKnobImage;
    if (mDragKnob && mKnobImagePressed)
        image = mKnobImagePressed;
    else if (mDragKnob || mHoverKnob)
        image = Highlighted(mKnobImage, mLitKnob, mLitKnobSource);
    const int32 x = KnobX();
    image->Merge(painter, image->Rect(), RectAt(mKnobRect, x, knobY), mDisabled ? DisabledOpacity : 1.0);
    mLastKnobX = x;
}

void CustomSlider::PaintReset(QPainter &painter)
{
    if (!IsResetShown() || !mResetImage)
        return;
    DIB *image = mHoverReset ? Highlighted(mResetImage, mLitReset, mLitResetSource) : mResetImage;
    const int32 x = int32(std::floor(ValueToPixel(mDefault) + 0.5));
    image->Merge(painter, image->Rect(), RectAt(mResetRect, x, mTrackRect.y1 + mResetTop));
}

} // namespace Orbane
