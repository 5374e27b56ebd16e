// The expression fields and the context menu of InputControl.

#include "orbane/InputControl.h"

#include "orbane/AutoParam.h"
#include "orbane/ClassIDs.h"
#include "orbane/Input.h"
#include "orbane/KeyframeMenu.h"
#include "orbane/OrbaneDoc.h"
#include "orbane/Parser.h"

#include <QContextMenuEvent>
#include <QKeyEvent>
#include <QLineEdit>
#include <QMenu>

#include <algorithm>
#include <cstring>
#include <string>
#include <utility>
#include <vector>

namespace Orbane {

namespace {

const char kExpressionAction[] = "Expression";
// The field of an expression that is refused or cannot be evaluated.
const QColor kErrorBase(0x8a, 0x2c, 0x2c);

// A text naming `value` computes from the number the Input holds now: that
// is a one-off calculation ("value * 2"); kept live, it would read itself.
bool NamesValue(const char *text)
{
    Parser parser;
    std::vector<std::string> names;
    return parser.UsedNames(text, names) && std::find(names.begin(), names.end(), "value") != names.end();
}

// Red with the reason as tip, or back to the control's own colours.
void MarkError(QLineEdit *edit, const QString &error)
{
    edit->setToolTip(error);
    edit->setProperty("expressionError", !error.isEmpty());
    QPalette palette = edit->parentWidget() ? edit->parentWidget()->palette() : QPalette();
    if (!error.isEmpty()) {
        palette.setColor(QPalette::Base, kErrorBase);
        palette.setColor(QPalette::Text, Qt::white);
    }
    edit->setPalette(palette);
}

} // namespace

QLineEdit *InputControl::GetExpressionEdit(int32 index) const
{
    if (index < 0 || std::size_t(index) >= mExpressionEdits.size())
        return nullptr;
    return mExpressionEdits[std::size_t(index)];
}

int32 InputControl::IndexOf(const QObject *edit) const
{
    for (std::size_t i = 0; i < mExpressionEdits.size(); ++i)
        if (edit && mExpressionEdits[i] == edit)
            return int32(i);
    return -1;
}

QLineEdit *InputControl::MakeExpressionEdit(int32 index)
{
    if (index < 0 || std::size_t(index) >= mInputs.size())
        return nullptr;
    if (QLineEdit *edit = GetExpressionEdit(index))
        return edit;
    mExpressionEdits.resize(mInputs.size());
    mExpressions.resize(mInputs.size());
    // A child of the control, so it has the control font already. Most
    // Inputs have no expression: an empty field is left without text, as
    // setting even an empty text lays the line out again.
    auto *edit = new QLineEdit(this);
    edit->setObjectName("expression");
    edit->setPlaceholderText("Expression");
    const OrbString &expression = mExpressions[std::size_t(index)];
    if (!expression.IsEmpty())
        edit->setText(QString::fromStdString(expression.str()));
    edit->setVisible(!expression.IsEmpty());
    edit->installEventFilter(this);
    connect(edit, SIGNAL(returnPressed()), this, SLOT(OnExpressionEntered()));
    mExpressionEdits[std::size_t(index)] = edit;
    return edit;
}

QLineEdit *InputControl::CreateExpressionEdit(const QRect &rect, int32 index)
{
    QLineEdit *edit = MakeExpressionEdit(index);
    if (edit && rect.isValid())
        edit->setGeometry(rect);
    return edit;
}

QLineEdit *InputControl::CreateExpressionEdit(Layout::Container *where, int32 index)
{
    const bool existed = GetExpressionEdit(index) != nullptr;
    QLineEdit *edit = MakeExpressionEdit(index);
    // CreateLayout moves fields that existed already into a new container.
    if (edit && where && (!existed || !where->Find(OrbID("expression." + std::to_string(index)))))
        where->AddWidget(OrbID("expression." + std::to_string(index)), edit);
    return edit;
}

QLineEdit *InputControl::EnsureExpressionEdit(int32 index)
{
    if (QLineEdit *edit = GetExpressionEdit(index))
        return edit;
    Layout::LayoutObj *where = FindLayoutObj("expression");
    return where && where->AsContainer() ? CreateExpressionEdit(where->AsContainer(), index)
                                         : CreateExpressionEdit(QRect(), index);
}

bool InputControl::AddExpressionEdit(int32 index, const TagList *)
{
    QLineEdit *edit = EnsureExpressionEdit(index);
    if (!edit)
        return false;
    edit->show();
    edit->setFocus(Qt::OtherFocusReason);
    Relayout();
    return true;
}

OrbString InputControl::GetExpressionData(int32 index) const
{
    if (index < 0 || std::size_t(index) >= mExpressions.size())
        return OrbString();
    return mExpressions[std::size_t(index)];
}

QRect InputControl::GetExpressionRect(int32 index) const
{
    const QLineEdit *edit = GetExpressionEdit(index);
    return edit && !edit->isHidden() ? edit->geometry() : QRect();
}

bool InputControl::RemoveExpressionAt(int32 index)
{
    if (index < 0 || std::size_t(index) >= mInputs.size())
        return false;
    Input *in = mInputs[std::size_t(index)];
    if (in->HasExpression() && !IsLocked()) {
        OpenUndo();
        AutoRef<Input>::Share(in)->SetExpression(nullptr);
        ResetUndo(nullptr);
    }
    HideExpressionField(index);
    return true;
}

void InputControl::HideExpressionField(int32 index)
{
    if (std::size_t(index) < mExpressions.size())
        mExpressions[std::size_t(index)] = OrbString();
    if (QLineEdit *edit = GetExpressionEdit(index)) {
        edit->clear();
        MarkError(edit, QString());
        edit->hide();
    }
    Relayout();
}

bool InputControl::ExpressionChanged(int32 index, const char *text)
{
    if (index < 0 || std::size_t(index) >= mInputs.size())
        return false;
    if (!text || !*text)
        return RemoveExpressionAt(index);
    Input *in = mInputs[std::size_t(index)];
    if (in->GetDataType() != CLSID_DataType_Number)
        return false;
    if (NamesValue(text))
        return EvaluateOnce(index, text);
    if (IsLocked())
        return false;
    std::string why;
    OpenUndo();
    const bool ok = AutoRef<Input>::Share(in)->SetExpression(text, 0, &why);
    ResetUndo(nullptr);
    if (ok) {
        mExpressions.resize(mInputs.size());
        mExpressions[std::size_t(index)] = OrbString(text);
    }
    ShowExpression(index, text, QString::fromStdString(why));
    return ok;
}

void InputControl::ShowExpression(int32 index, const char *text, const QString &error)
{
    QLineEdit *edit = EnsureExpressionEdit(index);
    if (!edit)
        return;
    if (!edit->hasFocus())
        edit->setText(QString::fromUtf8(text));
    MarkError(edit, error);
    if (edit->isHidden()) {
        edit->show();
        Relayout();
    }
}

void InputControl::SyncExpression(Input *input)
{
    for (std::size_t i = 0; i < mInputs.size(); ++i) {
        if (mInputs[i] != input)
            continue;
        const char *text = input->GetExpression();
        const char *error = input->GetExpressionError();
        const bool same = i < mShown.size() ? std::strcmp(mShown[i].text.c_str(), text) == 0 &&
                                                  std::strcmp(mShown[i].error.c_str(), error) == 0
                                            : !*text && !*error;
        if (same)
            continue;
        mShown.resize(mInputs.size());
        const OrbString was = std::exchange(mShown[i].text, OrbString(text));
        mShown[i].error = OrbString(error);
        mExpressions.resize(mInputs.size());
        if (*text) {
            mExpressions[i] = OrbString(text);
            ShowExpression(int32(i), text, QString::fromUtf8(error));
        } else if (mExpressions[i] == was) {
            HideExpressionField(int32(i));
        }
    }
}

bool InputControl::EvaluateOnce(int32 index, const char *text)
{
    Input *in = mInputs[std::size_t(index)];
    Parser parser;
    const AutoNumber now(in, GetCurrentTime());
    parser.SetVar("value", now ? now->Value : 0.0);
    parser.SetVar("time", GetCurrentTime());
    bool ok = parser.SetExpression(text);
    const float64 value = ok ? parser.Evaluate(&ok) : 0.0;
    if (QLineEdit *edit = GetExpressionEdit(index))
        MarkError(edit, ok ? QString() : QString::fromUtf8(parser.GetError()));
    if (!ok)
        return false;
    mExpressions.resize(mInputs.size());
    mExpressions[std::size_t(index)] = OrbString(text);
    return WriteExpression(index, value);
}

bool InputControl::WriteExpression(int32 index, float64 value)
{
    Input *in = mInputs[std::size_t(index)];
    if (IsLocked())
        return false;
    AutoNumber number(value);
    OpenUndo();
    const bool ok = AutoRef<Input>::Share(in)->SetValue(number, GetCurrentTime(), 0, nullptr);
    ResetUndo(nullptr);
    return ok;
}

bool InputControl::SetExpressions(const char *text, const TagList *)
{
    bool ok = true;
    for (std::size_t i = 0; i < mInputs.size(); ++i)
        ok = ExpressionChanged(int32(i), text) && ok;
    return ok;
}

void InputControl::OnOK()
{
    for (std::size_t i = 0; i < mExpressionEdits.size(); ++i)
        if (QLineEdit *edit = mExpressionEdits[i]; edit && edit->hasFocus())
            ExpressionChanged(int32(i), edit->text().toUtf8().constData());
}

void InputControl::OnCancel()
{
    for (std::size_t i = 0; i < mExpressionEdits.size(); ++i) {
        QLineEdit *edit = mExpressionEdits[i];
        if (!edit || !edit->hasFocus())
            continue;
        const OrbString kept = GetExpressionData(int32(i));
        edit->setText(QString::fromStdString(kept.str()));
        if (kept.IsEmpty()) {
            edit->hide();
            Relayout();
        }
    }
}

void InputControl::OnExpressionEntered()
{
    const int32 index = IndexOf(sender());
    if (QLineEdit *edit = GetExpressionEdit(index))
        ExpressionChanged(index, edit->text().toUtf8().constData());
}

bool InputControl::eventFilter(QObject *watched, QEvent *event)
{
    if (event->type() == QEvent::KeyPress && IndexOf(watched) >= 0 &&
        static_cast<QKeyEvent *>(event)->key() == Qt::Key_Escape) {
        OnCancel();
        return true;
    }
    return QWidget::eventFilter(watched, event);
}

void InputControl::AddToMenu(QMenu *menu)
{
    if (!menu || mInputs.empty() || mFlags & CF_ActionOnly)
        return;
    KeyframeMenu::AddTo(menu, mInputs.front(), IsLocked());
    QAction *action = menu->addAction(kExpressionAction, this, SLOT(OnExpressionMenu()));
    action->setCheckable(true);
    const QLineEdit *edit = GetExpressionEdit(0);
    action->setChecked(edit && !edit->isHidden());
}

void InputControl::OnExpressionMenu()
{
    const QLineEdit *edit = GetExpressionEdit(0);
    if (edit && !edit->isHidden())
        RemoveExpressionAt(0);
    else
        AddExpressionEdit(0, nullptr);
}

void InputControl::contextMenuEvent(QContextMenuEvent *event)
{
    QMenu menu(this);
    AddToMenu(&menu);
    if (menu.isEmpty()) {
        event->ignore();
        return;
    }
    menu.exec(event->globalPos());
}

} // namespace Orbane
