#include "orbane/ParameterPanel.h"

#include "orbane/FallbackControl.h"
#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptVal.h"

#include <QApplication>
#include <QResizeEvent>
#include <QScopedValueRollback>
#include <QScrollBar>
#include <algorithm>

namespace Orbane {

namespace {

// Keyboard users and screen readers go from control to control with Tab: a
// control without any child that takes focus that way (a separator, a
// label) takes it itself, so that it is announced with its Input's name.
void KeepInTabReach(InputControl *control)
{
    const auto children = control->findChildren<QWidget *>();
    const auto tabbable = [control](const QWidget *w) {
        return (w->focusPolicy() & Qt::TabFocus) && w->isVisibleTo(control); // a hidden expression field is no stop
    };
    if (std::none_of(children.begin(), children.end(), tabbable))
        control->setFocusPolicy(Qt::TabFocus);
}

// Room at the panel's sides, so edit boxes and captions do not touch its edges.
constexpr int32 kSideMargin = 6;

} // namespace

ParameterPanel::ParameterPanel(OrbaneDoc *doc, QWidget *parent) : QScrollArea(parent), mDoc(doc)
{
    setWidgetResizable(false);
    setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    setFrameShape(QFrame::NoFrame);
    setWidget(new QWidget);
    connect(doc, SIGNAL(toolRemoving(Orbane::Operator *)), this, SLOT(OnToolRemoving(Orbane::Operator *)));
    connect(verticalScrollBar(), SIGNAL(valueChanged(int)), this, SLOT(OnScrolled(int)));
}

ParameterPanel::~ParameterPanel()
{
    Clear();
}

void ParameterPanel::ShowTool(Operator *tool)
{
    if (tool == mTool)
        return;
    Clear();
    mTool = tool;
    if (tool) {
        for (Input *input : tool->Inputs())
            for (const TagItem *item = input->GetAttrs().Find(INPA_InputControl); item;
                 item = input->GetAttrs().FindNext(item))
                mSlots.push_back({input, item->id});
        // The page is built hidden and shown once: adding widgets one by one
        // to a visible page costs a relayout each.
        // A child of the view while it is built, so that a control can find
        // its inspector from Open on (a group header hides its rows there).
        QWidget *page = new QWidget(viewport());
        page->hide();
        mLaidOutWidth = viewport()->width();
        BuildUntil(page, 0, 1);
        PredictWidth();
        BuildUntil(page, 2 * viewport()->height(), kFirstBuilt);
        setWidget(page);
        ResizePage();
        page->show();
    }
    emit toolShown(tool);
}

// Builds the next controls in Input order until the built ones reach `bottom`
// and at least `count` are built, each placed under the one before.
void ParameterPanel::BuildUntil(QWidget *page, int32 bottom, size_t count)
{
    const int32 inner = InnerWidth();
    const QScopedValueRollback<bool> building(mBuilding, true);
    while (mControls.size() < mSlots.size() && (mBuiltBottom < bottom || mControls.size() < count)) {
        const Slot &slot = mSlots[mControls.size()];
        InputControl *control = CreateControl(slot.input, slot.classID.c_str(), page);
        mControls.push_back(control);
        Place(control, inner);
    }
}

// The controls are opened on the page they live on: opening one on a page in
// the window and moving it to another walks the window's focus chain.
InputControl *ParameterPanel::CreateControl(Input *input, const char *classID, QWidget *page)
{
    const TagList &attrs = input->GetAttrs();
    const Registry *reg = ClassRegistry.FindScriptName(classID);
    auto *control = reg ? dynamic_cast<InputControl *>(reg->New(ScriptVal(), attrs)) : nullptr;
    if (!control) {
        qWarning("inspector: Input \"%s\" of tool \"%s\" names control class \"%s\", which %s; showing its value",
                 input->GetName(), mTool->GetName(), classID, reg ? "is no inspector control" : "is unknown");
        control = new FallbackControl(nullptr, ScriptVal(), attrs);
    }
    control->AddInput(input, &attrs);
    control->SetAttrsTagList(input, attrs);
    control->Open(page, QRect(), nullptr);
    KeepInTabReach(control);
    return control;
}

std::vector<InputControl *> ParameterPanel::ControlsOf(const Input *input)
{
    size_t last = 0;
    for (size_t i = 0; i < mSlots.size(); ++i)
        if (mSlots[i].input == input)
            last = i + 1;
    if (last > mControls.size() && widget())
        BuildThrough(last);
    std::vector<InputControl *> found;
    for (InputControl *c : mControls)
        for (Input *in : c->Inputs())
            if (in == input)
                found.push_back(c);
    return found;
}

// Many controls added to a shown page cost a relayout and a repaint each, so
// a long build hides the page, unless the user is typing in it.
void ParameterPanel::BuildThrough(size_t count)
{
    QWidget *page = widget();
    const bool hide =
        count - mControls.size() > kFirstBuilt && page->isVisible() && !page->isAncestorOf(QApplication::focusWidget());
    if (hide)
        page->hide();
    BuildUntil(page, 0, count);
    ResizePage();
    if (hide)
        page->show();
}

// The vertical scroll bar comes or goes with the new page, narrowing or
// widening the view, which would size every built control twice. From the
// first control's height the page's height is foreseen, and the first
// control sized again at the width the view will have; where the guess is
// wrong, the resize that follows lays out again.
void ParameterPanel::PredictWidth()
{
    QScrollBar *bar = verticalScrollBar();
    if (mControls.empty() || verticalScrollBarPolicy() != Qt::ScrollBarAsNeeded)
        return;
    const int32 height = (mBuiltBottom - kSideMargin) * int32(mSlots.size()) + 2 * kSideMargin;
    // The viewport as it would be without scroll bars: whether the bar shows
    // just now says nothing (the last tool's, or none before the first show).
    const QSize full = maximumViewportSize();
    const bool needed = height > full.height();
    const int32 width = full.width() - (needed ? bar->sizeHint().width() : 0);
    if (width == mLaidOutWidth || width < 1)
        return;
    mLaidOutWidth = width;
    mBuiltBottom = kSideMargin;
    Place(mControls.front(), InnerWidth());
}

int32 ParameterPanel::InnerWidth() const
{
    return qMax(1, mLaidOutWidth - 2 * kSideMargin);
}

void ParameterPanel::Place(InputControl *control, int32 inner)
{
    if (IsInputHidden(control->GetCurrentInput())) {
        control->hide();
        return;
    }
    int32 w = inner, h = 0;
    control->SetSize(w, h, nullptr);
    control->setGeometry(kSideMargin, mBuiltBottom, inner, h);
    control->show();
    mBuiltBottom += h;
}

// The page is as high as the built controls, plus the unbuilt ones at the
// built ones' mean height.
void ParameterPanel::ResizePage()
{
    const size_t built = mControls.size(), unbuilt = mSlots.size() - built;
    const int32 mean = built ? (mBuiltBottom - kSideMargin) / int32(built) : 0;
    widget()->resize(mLaidOutWidth, mBuiltBottom + mean * int32(unbuilt) + kSideMargin);
}

void ParameterPanel::LayOut()
{
    const int32 width = viewport()->width();
    if (width == mLaidOutWidth || !widget())
        return;
    mLaidOutWidth = width;
    mBuiltBottom = kSideMargin;
    const int32 inner = InnerWidth();
    for (InputControl *c : mControls)
        Place(c, inner);
    ResizePage();
}

// Builds ahead of the view by a screen, so scrolling finds controls there.
void ParameterPanel::OnScrolled(int value)
{
    const int32 ahead = value + 2 * viewport()->height();
    if (mControls.size() < mSlots.size() && widget() && mBuiltBottom < ahead) {
        BuildUntil(widget(), ahead + viewport()->height(), 0);
        ResizePage();
    }
}

void ParameterPanel::HideInputs(const std::vector<Input *> &inputs, bool hide)
{
    for (const Input *in : inputs) {
        int32 &count = mHiddenBy[in];
        count = qMax(0, count + (hide ? 1 : -1));
        if (count == 0)
            mHiddenBy.erase(in);
    }
    Reflow();
}

bool ParameterPanel::IsInputHidden(const Input *input) const
{
    return input && mHiddenBy.count(input) != 0;
}

ParameterPanel *ParameterPanel::Of(const QWidget *control)
{
    for (QWidget *w = control ? control->parentWidget() : nullptr; w; w = w->parentWidget())
        if (auto *panel = qobject_cast<ParameterPanel *>(w))
            return panel;
    return nullptr;
}

// Places every built control again at the width they have, then builds on
// where the rows that went hidden left room in the view.
void ParameterPanel::Reflow()
{
    // A header hides only rows after its own, which a build places as it
    // reaches them.
    if (mBuilding || !widget() || mControls.empty())
        return;
    mBuiltBottom = kSideMargin;
    const int32 inner = InnerWidth();
    for (InputControl *c : mControls)
        Place(c, inner);
    ResizePage();
    OnScrolled(verticalScrollBar()->value());
}

void ParameterPanel::resizeEvent(QResizeEvent *event)
{
    QScrollArea::resizeEvent(event);
    LayOut();
    OnScrolled(verticalScrollBar()->value());
}

void ParameterPanel::OnToolRemoving(Operator *tool)
{
    if (tool == mTool)
        ShowTool(nullptr);
}

// Unbinds and destroys every control. A script may still hold one, so that
// one leaves the page before its reference is dropped; the others are
// destroyed in place. Taking a widget out of its window walks the window's
// whole focus chain, so unparenting every control made clearing quadratic.
void ParameterPanel::Clear()
{
    for (InputControl *c : mControls) {
        const std::vector<Input *> inputs = c->Inputs();
        for (Input *in : inputs)
            c->OnDisconnect(in, nullptr);
        if (c->RefCount() > 1)
            c->setParent(nullptr);
        c->DecRef();
    }
    mControls.clear();
    mSlots.clear();
    mBuiltBottom = kSideMargin;
    mHiddenBy.clear();
    mTool = nullptr;
}

} // namespace Orbane
