#include "orbane/LayoutObj.h"

#include <algorithm>

namespace Orbane {
namespace Layout {

namespace {

constexpr int kMaxSize = QLAYOUTSIZE_MAX;

int Bound(int value, int lo, int hi)
{
    if (hi >= 0 && value > hi)
        value = hi;
    if (lo >= 0 && value < lo)
        value = lo;
    return value;
}

} // namespace

LayoutObj::LayoutObj(const OrbID &name, QWidget *widget)
    : mName(name), mWidget(widget), mItem(widget ? std::make_unique<QWidgetItem>(widget) : nullptr),
      mIsGap(widget == nullptr)
{
}

LayoutObj::~LayoutObj() = default;

void LayoutObj::SetFixedSize(int32 width, int32 height)
{
    mFixed = QSize(width, height);
}

void LayoutObj::SetMinSize(int32 width, int32 height)
{
    mMin = QSize(width, height);
}

void LayoutObj::SetMaxSize(int32 width, int32 height)
{
    mMax = QSize(width, height);
}

void LayoutObj::SetExpanding(bool expanding)
{
    mExpanding = expanding;
}

void LayoutObj::SetAlign(Qt::Alignment align)
{
    setAlignment(align);
}

bool LayoutObj::SetAttrs(const TagList &tags)
{
    if (!tags.FindQuery(INPA_LayoutHeight))
        return false;
    const int32 height = tags.GetInt(INPA_LayoutHeight, -1);
    mHeightOverride = height < 0 ? -1 : height;
    return true;
}

int32 LayoutObj::GetHeight() const
{
    return sizeHint().height();
}

QLayoutItem *LayoutObj::Content() const
{
    return mWidget ? mItem.get() : nullptr;
}

bool LayoutObj::ContentIsEmpty() const
{
    // A gap is there by design; a widget that was deleted or hidden is not.
    if (mIsGap)
        return false;
    return !mWidget || mItem->isEmpty();
}

QSize LayoutObj::OwnHint() const
{
    const QLayoutItem *content = Content();
    QSize hint = content ? content->sizeHint() : QSize(0, 0);
    hint.setWidth(Bound(mFixed.width() >= 0 ? mFixed.width() : hint.width(), mMin.width(), mMax.width()));
    hint.setHeight(HasFixedHeight() ? FixedHeight() : Bound(hint.height(), mMin.height(), mMax.height()));
    return hint;
}

QSize LayoutObj::OwnMin() const
{
    const QLayoutItem *content = Content();
    QSize min = content ? content->minimumSize() : QSize(0, 0);
    if (mFixed.width() >= 0)
        min.setWidth(mFixed.width());
    else
        min.setWidth(Bound(std::max(min.width(), mMin.width()), -1, mMax.width()));
    if (HasFixedHeight())
        min.setHeight(FixedHeight());
    else
        min.setHeight(Bound(std::max(min.height(), mMin.height()), -1, mMax.height()));
    return min;
}

QSize LayoutObj::OwnMax() const
{
    const QLayoutItem *content = Content();
    QSize max = content ? content->maximumSize() : (mExpanding ? QSize(kMaxSize, kMaxSize) : OwnHint());
    if (mFixed.width() >= 0)
        max.setWidth(mFixed.width());
    else if (mMax.width() >= 0)
        max.setWidth(std::min(max.width(), mMax.width()));
    if (HasFixedHeight())
        max.setHeight(FixedHeight());
    else if (mMax.height() >= 0)
        max.setHeight(std::min(max.height(), mMax.height()));
    return max.expandedTo(OwnMin());
}

// Qt's boxes count the sizes of empty items too; an empty object (hidden,
// deleted or unfilled) must therefore need nothing and limit nothing.
QSize LayoutObj::sizeHint() const
{
    if (isEmpty())
        return QSize(0, 0);
    return OwnHint().expandedTo(OwnMin()).boundedTo(OwnMax());
}

QSize LayoutObj::minimumSize() const
{
    return isEmpty() ? QSize(0, 0) : OwnMin();
}

QSize LayoutObj::maximumSize() const
{
    if (isEmpty())
        return QSize(kMaxSize, kMaxSize);
    // An aligned object accepts any cell and sits inside it (AlignedRect).
    QSize max = OwnMax();
    if (alignment() & Qt::AlignHorizontal_Mask)
        max.setWidth(kMaxSize);
    if (alignment() & Qt::AlignVertical_Mask)
        max.setHeight(kMaxSize);
    return max;
}

Qt::Orientations LayoutObj::expandingDirections() const
{
    const QLayoutItem *content = Content();
    Qt::Orientations dirs = content ? content->expandingDirections() : Qt::Orientations();
    if (mExpanding)
        dirs |= Qt::Horizontal | Qt::Vertical;
    if (mFixed.width() >= 0)
        dirs &= ~Qt::Horizontal;
    if (HasFixedHeight())
        dirs &= ~Qt::Vertical;
    return dirs;
}

bool LayoutObj::isEmpty() const
{
    return ContentIsEmpty();
}

QRect LayoutObj::AlignedRect(const QRect &cell) const
{
    const Qt::Alignment align = alignment();
    QSize size = cell.size().boundedTo(OwnMax());
    const QSize hint = sizeHint();
    if (align & Qt::AlignHorizontal_Mask)
        size.setWidth(std::min(size.width(), hint.width()));
    if (hasHeightForWidth())
        size.setHeight(std::min(size.height(), heightForWidth(size.width())));
    else if (align & Qt::AlignVertical_Mask)
        size.setHeight(std::min(size.height(), hint.height()));

    int x = cell.x();
    int y = cell.y();
    if (align & Qt::AlignRight)
        x += cell.width() - size.width();
    else if (align & Qt::AlignHCenter)
        x += (cell.width() - size.width()) / 2;
    if (align & Qt::AlignBottom)
        y += cell.height() - size.height();
    else if (align & Qt::AlignVCenter)
        y += (cell.height() - size.height()) / 2;
    return QRect(QPoint(x, y), size);
}

void LayoutObj::setGeometry(const QRect &rect)
{
    mRect = AlignedRect(rect);
    // The widget gets the rectangle as it is: a height set by tag must win
    // over the widget's own fixed height, which QWidgetItem would keep.
    if (mWidget)
        mWidget->setGeometry(mRect);
    else if (QLayoutItem *content = Content())
        content->setGeometry(mRect);
}

QRect LayoutObj::geometry() const
{
    return mRect;
}

bool LayoutObj::hasHeightForWidth() const
{
    const QLayoutItem *content = Content();
    return !HasFixedHeight() && content && content->hasHeightForWidth();
}

int LayoutObj::heightForWidth(int width) const
{
    if (HasFixedHeight())
        return FixedHeight();
    const QLayoutItem *content = Content();
    if (!content || !content->hasHeightForWidth())
        return -1;
    if (mFixed.width() >= 0)
        width = mFixed.width();
    return Bound(content->heightForWidth(width), mMin.height(), mMax.height());
}

int LayoutObj::minimumHeightForWidth(int width) const
{
    return heightForWidth(width);
}

QWidget *LayoutObj::widget()
{
    return mWidget.data();
}

void LayoutObj::invalidate()
{
    if (QLayoutItem *content = Content())
        content->invalidate();
}

} // namespace Layout
} // namespace Orbane
