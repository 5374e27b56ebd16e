#include "ToolFixture.h"
#include "LoadControlModule.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Operator.h"
#include "orbane/RegistryList.h"
#include "orbane/ScriptVal.h"
#include "orbane/ScriptValParam.h"

#include <QApplication>
#include <QMouseEvent>
#include <QTest>

#include <algorithm>
#include <dlfcn.h>

namespace Orbane {
namespace Test {

ToolFixture::ToolFixture(const char *toolName) : tool(new Operator(toolName, "TestTool"))
{
    doc.AddTool(tool);
    tool->DecRef();
    page.resize(kWidth + 40, 600);
    page.show();
    if (!QTest::qWaitForWindowExposed(&page))
        qWarning("ToolFixture: the page was never exposed");
}

ToolFixture::~ToolFixture()
{
    while (!mControls.empty())
        Destroy(mControls.back());
}

Input *ToolFixture::AddNumber(const char *id, float64 value, const TagList &attrs)
{
    return tool->AddInput(OrbID(id), id, CLSID_DataType_Number, attrs, AutoNumber(value));
}

Input *ToolFixture::AddPoint(const char *id, float64 x, float64 y, const TagList &attrs)
{
    return tool->AddInput(OrbID(id), id, CLSID_DataType_Point, attrs, AutoPoint(x, y));
}

Input *ToolFixture::AddTable(const char *id, const ScriptVal &value, const TagList &attrs)
{
    return tool->AddInput(OrbID(id), id, CLSID_DataType_ScriptVal, attrs, AutoScriptValParam(value));
}

ScriptVal ToolFixture::TableOf(const Input *input) const
{
    const AutoScriptValParam value(const_cast<Input *>(input), doc.GetCurrentTime());
    return value ? value->Value : ScriptVal();
}

InputControl *ToolFixture::Bind(InputControl *control, const std::vector<Input *> &inputs, int32 width)
{
    if (!control)
        return nullptr;
    mControls.push_back(control);
    for (Input *in : inputs)
        control->AddInput(in, &in->GetAttrs());
    if (!inputs.empty())
        control->SetAttrsTagList(inputs.front(), inputs.front()->GetAttrs());
    control->Open(&page, QRect(), nullptr);
    Resize(control, width);
    return control;
}

InputControl *ToolFixture::Create(const OrbID &classID, const std::vector<Input *> &inputs, int32 width)
{
    const TagList tags = inputs.empty() ? TagList() : inputs.front()->GetAttrs();
    ScriptObject *obj = ClassRegistry.New(classID, ScriptVal(), tags);
    auto *control = dynamic_cast<InputControl *>(obj);
    if (!control && obj)
        obj->DecRef();
    return Bind(control, inputs, width);
}

int32 ToolFixture::Resize(InputControl *control, int32 width)
{
    int32 height = 0;
    control->SetSize(width, height, nullptr);
    Place();
    return height;
}

void ToolFixture::Place()
{
    int32 y = 0;
    for (InputControl *c : mControls) {
        c->move(0, y);
        y += c->height();
    }
}

void ToolFixture::Destroy(InputControl *control)
{
    const auto it = std::find(mControls.begin(), mControls.end(), control);
    if (it == mControls.end())
        return;
    mControls.erase(it);
    for (Input *in : std::vector<Input *>(control->Inputs()))
        control->OnDisconnect(in, nullptr);
    control->setParent(nullptr);
    control->DecRef();
}

bool ToolFixture::LoadControls(std::string *error)
{
    return LoadControlModule(error);
}

int32 ToolFixture::LayoutReadCount(const char *itemName)
{
    using Count = int32 (*)(const char *);
    const auto count = reinterpret_cast<Count>(dlsym(RTLD_DEFAULT, "orbanecontrols_LayoutReadCount"));
    return count ? count(itemName) : -1;
}

void ToolFixture::DragSideways(QWidget *w, const std::vector<int32> &steps, Qt::KeyboardModifiers mods)
{
    QPoint at(w->width() / 2, w->height() / 2);
    QTest::mousePress(w, Qt::LeftButton, mods, at);
    for (int32 dx : steps) {
        at.rx() += dx;
        QMouseEvent move(QEvent::MouseMove, at, w->mapToGlobal(at), Qt::NoButton, Qt::LeftButton, mods);
        QApplication::sendEvent(w, &move);
    }
    QTest::mouseRelease(w, Qt::LeftButton, mods, at);
}

float64 ToolFixture::NumberOf(const Input *input) const
{
    const AutoNumber value(const_cast<Input *>(input), doc.GetCurrentTime());
    return value ? value->Value : -12345.0;
}

} // namespace Test
} // namespace Orbane
