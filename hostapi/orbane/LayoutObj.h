#pragma once

#include "orbane/OrbID.h"
#include "orbane/TagList.h"
#include "orbane/Types.h"

#include <QLayoutItem>
#include <QPointer>
#include <QWidget>

#include <memory>

namespace Orbane {
namespace Layout {

class Container;

// One named place in a control's layout: a child widget, an empty gap, or
// (as a Container) a row, column or grid of further places. It is a Qt
// layout item, so Qt's box and grid layouts do the solving; on top of the
// child's own size rules it applies the description's fixed, minimum and
// maximum sizes and a height that the control may set later by tag.
//
// The child widget is only watched (QPointer), never owned: a control may
// delete its children before its layout.
class LayoutObj : public QLayoutItem
{
public:
    // A place for `widget`; a null widget makes an empty gap that has only
    // the sizes the description gives it.
    LayoutObj(const OrbID &name, QWidget *widget);
    ~LayoutObj() override;
    LayoutObj(const LayoutObj &) = delete;
    LayoutObj &operator=(const LayoutObj &) = delete;

    const OrbID &GetName() const { return mName; }
    QWidget *GetWidget() const { return mWidget.data(); }
    virtual Container *AsContainer() { return nullptr; }

    // Size rules; -1 leaves a rule unset.
    void SetFixedSize(int32 width, int32 height);
    void SetMinSize(int32 width, int32 height);
    void SetMaxSize(int32 width, int32 height);
    // A gap that takes the room nobody else wants.
    void SetExpanding(bool expanding);
    // Keeps the object at its preferred size inside a larger cell, placed
    // by the alignment, instead of filling the cell.
    void SetAlign(Qt::Alignment align);

    // Applies INPA_LayoutHeight (0x10020007): the object takes exactly this
    // height; a negative value gives the height back to the object's own
    // rules. Returns true where the list held a tag this object knows.
    bool SetAttrs(const TagList &tags);
    // The height set by tag, or -1.
    int32 GetHeightOverride() const { return mHeightOverride; }
    // The height the object asks for: the tag's, else the description's,
    // else its content's preferred height.
    int32 GetHeight() const;
    // Where the object was last placed, in the owner widget's coordinates.
    QRect GetRect() const { return mRect; }

    QSize sizeHint() const override;
    QSize minimumSize() const override;
    QSize maximumSize() const override;
    Qt::Orientations expandingDirections() const override;
    bool isEmpty() const override;
    void setGeometry(const QRect &rect) override;
    QRect geometry() const override;
    bool hasHeightForWidth() const override;
    int heightForWidth(int width) const override;
    int minimumHeightForWidth(int width) const override;
    QWidget *widget() override;
    void invalidate() override;

protected:
    // What the content asks for, before this object's own rules.
    virtual QLayoutItem *Content() const;
    virtual bool ContentIsEmpty() const;

private:
    QSize OwnHint() const;
    QSize OwnMin() const;
    QSize OwnMax() const;
    QRect AlignedRect(const QRect &cell) const;
    bool HasFixedHeight() const { return mHeightOverride >= 0 || mFixed.height() >= 0; }
    int FixedHeight() const { return mHeightOverride >= 0 ? mHeightOverride : mFixed.height(); }

    OrbID mName;
    QPointer<QWidget> mWidget;
    std::unique_ptr<QWidgetItem> mItem;
    bool mIsGap;
    QRect mRect;
    QSize mFixed{-1, -1};
    QSize mMin{-1, -1};
    QSize mMax{-1, -1};
    int32 mHeightOverride = -1;
    bool mExpanding = false;
};

} // namespace Layout
} // namespace Orbane
