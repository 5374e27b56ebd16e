#include "orbane/ParameterPanel.h"

#include "orbane/FallbackControl.h"
#include "orbane/Input.h"
#include "orbane/InputControl.h"
#include "orbane/Operator.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Registry.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptVal.h"

#include <QResizeEvent>

namespace Orbane {

namespace {

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
        // The page is built hidden and shown once: adding widgets one by one
        // to a visible page costs a relayout each.
        QWidget *page = new QWidget;
        page->hide();
        for (Input *input : tool->Inputs())
            for (const TagItem *item = input->GetAttrs().Find(INPA_InputControl); item;
                 item = input->GetAttrs().FindNext(item))
                if (InputControl *control = CreateControl(input, item->id.c_str())) {
                    control->setParent(page);
                    mControls.push_back(control);
                }
        setWidget(page);
        mLaidOutWidth = -1;
        LayOut();
        page->show();
    }
    emit toolShown(tool);
}

InputControl *ParameterPanel::CreateControl(Input *input, const char *classID)
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
    control->Open(widget(), QRect(), nullptr);
    return control;
}

std::vector<InputControl *> ParameterPanel::ControlsOf(const Input *input) const
{
    std::vector<InputControl *> found;
    for (InputControl *c : mControls)
        for (Input *in : c->Inputs())
            if (in == input)
                found.push_back(c);
    return found;
}

void ParameterPanel::LayOut()
{
    const int32 width = viewport()->width();
    if (width == mLaidOutWidth || !widget())
        return;
    mLaidOutWidth = width;
    const int32 inner = qMax(1, width - 2 * kSideMargin);
    int32 y = kSideMargin;
    for (InputControl *c : mControls) {
        int32 w = inner, h = 0;
        c->SetSize(w, h, nullptr);
        c->setGeometry(kSideMargin, y, inner, h);
        c->show();
        y += h;
    }
    widget()->resize(width, y + kSideMargin);
}

void ParameterPanel::resizeEvent(QResizeEvent *event)
{
    QScrollArea::resizeEvent(event);
    LayOut();
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
    mTool = nullptr;
}

} // namespace Orbane
