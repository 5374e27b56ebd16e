#include "InputStateMark.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/KeyframeMenu.h"

#include <QPainter>

namespace Orbane {

namespace {

// The key colour of the time ruler's marks, and a quieter one between keys.
const QColor kOnKeyColour(240, 190, 60);
const QColor kAnimatedColour(110, 140, 200);

} // namespace

InputStateMark::InputStateMark(QWidget *control) : QWidget(control)
{
    setObjectName("inputStateMark");
    setAttribute(Qt::WA_TransparentForMouseEvents);
    setFocusPolicy(Qt::NoFocus);
    hide();
}

void InputStateMark::Update(QWidget *control, const Input *input, const Parameter *value)
{
    if (!control || !input)
        return;
    const AutoParameter now(value ? nullptr : input->GetValue(input->CurrentTime()));
    const QString name = QString::fromUtf8(input->GetName());
    if (control->accessibleName() != name)
        control->setAccessibleName(name);
    control->setAccessibleDescription(ValueText(value ? value : now.get()));
    const State state = StateOf(input);
    auto *mark = control->findChild<InputStateMark *>(QString(), Qt::FindDirectChildrenOnly);
    if (!mark && state == State::Plain)
        return;
    if (!mark)
        mark = new InputStateMark(control);
    mark->setGeometry(0, 0, kWidth, control->height());
    mark->raise();
    mark->SetState(state);
}

InputStateMark::State InputStateMark::StateOf(const Input *input)
{
    if (!input->IsAnimated())
        return State::Plain;
    return KeyframeMenu::HasKeyNow(input) ? State::OnKey : State::Animated;
}

QString InputStateMark::ValueText(const Parameter *value)
{
    if (!value)
        return QString();
    if (const auto *n = dynamic_cast<const Number *>(value))
        return QString::number(n->Value);
    if (const auto *p = dynamic_cast<const Point *>(value))
        return QString("%1, %2").arg(p->X).arg(p->Y);
    if (const auto *t = dynamic_cast<const Text *>(value))
        return QString::fromUtf8(t->Value.c_str());
    if (const auto *id = dynamic_cast<const OrbIDParam *>(value))
        return QString::fromUtf8(id->Value.c_str());
    return QString::fromUtf8(value->DataType().c_str());
}

void InputStateMark::SetState(State state)
{
    setVisible(state != State::Plain);
    if (state == mState)
        return;
    mState = state;
    update();
}

void InputStateMark::paintEvent(QPaintEvent *)
{
    QPainter painter(this);
    painter.fillRect(rect(), mState == State::OnKey ? kOnKeyColour : kAnimatedColour);
}

} // namespace Orbane
